// Retargeting takes both skeletons to stand in a T-pose at rest. A file that is being read has no body map
// yet; the arms are found by the names of the hands.

#include "RestPose.h"

#include "BodyStance.h"
#include "BodyTree.h"
#include "CFailure.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>
#include <string>

namespace gw {

namespace {

constexpr const char* kHandWords[] = {"hand", "wrist"};

bool IsHand(const CNode* node)
{
    const std::string name = LowerCase(node->NameView());
    return std::ranges::any_of(kHandWords, [&](const char* word) { return name.find(word) != name.npos; });
}

BodyArm ArmOf(CNode& hand)
{
    CNode* const forearm = hand.GetParentNode();
    return {nullptr, forearm ? forearm->GetParentNode() : nullptr, forearm, &hand};
}

} // namespace

void JudgeRestPose(CNode& motionRoot, CFailureRecord& record)
{
    // Fingers are called after their hand, so the first hand is the one that is under no other.
    const std::vector<CNode*> nodes = NodesOf(motionRoot);
    const auto first = std::ranges::find_if(nodes, IsHand);
    const auto isOther = [&](const CNode* node) { return IsHand(node) && !IsAtOrBelow(node, *first); };
    const auto second = std::find_if(first, nodes.end(), isOther);
    if (second == nodes.end() || DepthOf(*first) != DepthOf(*second))
        return;
    CBodyMap body;
    body.arms = {ArmOf(**first), ArmOf(**second)};
    const CNode* const arm = body.arms[0].upperArm;
    if (!arm || arm == body.arms[1].upperArm)
        return;
    const ERestPose pose = RestStanceOf(body).Verdict();
    if (pose != ERestPose::Unknown && pose != ERestPose::TPose)
        record.Warn(EFailure::RestPose, 0, std::string(arm->NameView()));
}

} // namespace gw
