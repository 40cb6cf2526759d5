// Retargeting takes both skeletons to stand in a T-pose at rest. Whether a source does can be told without
// knowing which way is up: in a T-pose both arms go on along the line from one upper arm to the other.

#include "RestPose.h"

#include "CKeyframeControl.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>
#include <string>

namespace gw {

namespace {

// Cosine of the angle to the line through both upper arms that still counts as sideways, 32 degrees. In
// T-poses of real files the angle is 6 degrees at the most, in all other rest poses 43 or more.
constexpr double kSideways = 0.85;
constexpr const char* kHandWords[] = {"hand", "wrist"};

bool IsHand(const CNode* node)
{
    const std::string name = LowerCase(node->NameView());
    return std::ranges::any_of(kHandWords, [&](const char* word) { return name.find(word) != name.npos; });
}

bool IsUnder(const CNode* node, const CNode* ancestor)
{
    while (node && node != ancestor)
        node = node->GetParentNode();
    return node != nullptr;
}

size_t Depth(const CNode* node)
{
    size_t depth = 0;
    for (; node; node = node->GetParentNode())
        ++depth;
    return depth;
}

// Two joints up from the hand, or null.
const CNode* UpperArm(const CNode* hand)
{
    const CNode* const forearm = hand->GetParentNode();
    return forearm ? forearm->GetParentNode() : nullptr;
}

const Mat4& RestMatrix(const CNode& node)
{
    CControl* const control = node.GetControl();
    const auto* track = dynamic_cast<const CKeyframeControl*>(control);
    return track && track->m_bHasRestMatrix ? track->m_kRestMatrix : node.m_kMatrix;
}

Vec3 RestPosition(const CNode* node)
{
    Vec3 position = kVec3Zero;
    for (; node; node = node->GetParentNode())
        position = TransformCoord(position, RestMatrix(*node));
    return position;
}

bool PointsAlong(const Vec3& direction, const Vec3& axis)
{
    return Vec3Dot(direction, axis) >= kSideways * Vec3Length(direction) * Vec3Length(axis);
}

} // namespace

void JudgeRestPose(CNode& motionRoot, CFailureRecord& record)
{
    // Fingers are called after their hand, so the first hand is the one that is under no other.
    const std::vector<CNode*> nodes = NodesOf(motionRoot);
    const auto first = std::ranges::find_if(nodes, IsHand);
    const auto isOther = [&](const CNode* node) { return IsHand(node) && !IsUnder(node, *first); };
    const auto second = std::find_if(first, nodes.end(), isOther);
    if (second == nodes.end() || Depth(*first) != Depth(*second))
        return;
    const CNode* const arm = UpperArm(*first);
    const CNode* const otherArm = UpperArm(*second);
    if (!arm || arm == otherArm)
        return;
    const Vec3 sideways = RestPosition(arm) - RestPosition(otherArm);
    const bool both = PointsAlong(RestPosition(*first) - RestPosition(arm), sideways) &&
                      PointsAlong(RestPosition(*second) - RestPosition(otherArm), -sideways);
    if (!both)
        record.Warn(EFailure::RestPose, 0, std::string(arm->NameView()));
}

} // namespace gw
