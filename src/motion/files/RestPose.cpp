// Retargeting expects both skeletons to be in a T-pose at rest. While a file is being read there is no body
// map yet, so the arms are found by the names of the hands.

#include "RestPose.h"

#include "BodyStance.h"
#include "BodyTree.h"
#include "CFailureRecord.h"
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
    // Fingers are named after their hand, so the hand is the match that is not below another match.
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
