// Measures how far each target bone would be rotated about itself. For every pose, the row's offset is
// applied to the source bone, and the target's rest pose, swung to the source bone's direction by the
// smallest rotation, is the reference. The remaining angle between both is the error.

#include "RowTurns.h"

#include "BodyTree.h"
#include "CBodyPoses.h"
#include "CPoseMatcher.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace gw {

namespace {

// The joint that gives a target bone its direction. The torso's two ends, the head and the feet carry several
// joints or none, so they have no direction to swing to.
struct LeadRow
{
    const char* bone;
    const char* next; ///< or null
    bool isHand;      ///< points to its own fingers
};

constexpr LeadRow kLeads[] = {
    {kRootBone,            nullptr,              false},
    {kWaistBone,           kTorsoBone,           false},
    {kTorsoBone,           nullptr,              false},
    {kNeckBone,            kHeadBone,            false},
    {kHeadBone,            nullptr,              false},
    {kLeftBones.collar,    kLeftBones.upperArm,  false},
    {kLeftBones.upperArm,  kLeftBones.forearm,   false},
    {kLeftBones.forearm,   kLeftBones.hand,      false},
    {kLeftBones.hand,      nullptr,              true },
    {kLeftBones.foot,      nullptr,              false},
    {kRightBones.collar,   kRightBones.upperArm, false},
    {kRightBones.upperArm, kRightBones.forearm,  false},
    {kRightBones.forearm,  kRightBones.hand,     false},
    {kRightBones.hand,     nullptr,              true },
    {kRightBones.foot,     nullptr,              false},
};

// A row of the table with the nodes that define its direction.
struct Lead
{
    CNode* target;
    CNode* source;
    const CNode* from;        ///< start of the direction
    std::vector<CNode*> next; ///< the direction ends in the middle of these
};

// A hand without fingers continues the forearm.
void LeadToFingers(Lead& hand)
{
    hand.next = ChildNodes(*hand.source);
    if (!hand.next.empty())
        return;
    hand.from = hand.source->GetParentNode();
    if (hand.from)
        hand.next = {hand.source};
}

std::vector<Lead> FindLeads(const CRetargeter& table, const CNodeNames& targets)
{
    std::vector<Lead> leads;
    for (const LeadRow& row : kLeads)
    {
        CNode* const target = targets.Find(row.bone);
        CNode* const source = table.SourceOf(target);
        if (!source)
            continue;
        leads.push_back({target, source, source, {}});
        if (CNode* const next = row.next ? table.SourceOf(targets.Find(row.next)) : nullptr)
            leads.back().next = {next};
        if (row.isHand)
            LeadToFingers(leads.back());
    }
    return leads;
}

// Positions near the limits of 32-bit floats yield NaN; such a bone counts as completely wrong.
double AngleBetweenRotations(const Mat3& a, const Mat3& b)
{
    const double angle = AngleOf(a * Mat3Transpose(b));
    return std::isfinite(angle) ? angle : 180.0;
}

// Returns where the source's bone points, in the body's own axes; nothing if joints coincide.
std::optional<Vec3> Direction(const Lead& lead, const CBodyPoses& poses, const Mat3& toBody)
{
    if (lead.next.empty())
        return std::nullopt;
    const Vec3 from = poses.Place(*lead.from);
    Vec3 sum = kVec3Zero;
    for (const CNode* node : lead.next)
        sum = sum + (poses.Place(*node) - from);
    const Vec3 direction = Vec3Normalized(sum);
    if (direction == kVec3Zero)
        return std::nullopt;
    return TransformCoord(direction, Mat4Compose(toBody, kVec3Zero));
}

double Turn(const Lead& lead, const CRetargeter& table, const CBodyPoses& poses, const Mat4& targetAtRest,
            const Mat3& toBody)
{
    const Mat3 offset = OffsetRotation(table.OffsetAngles(lead.target), table.OffsetMatrix(lead.target));
    const Mat3 turned = offset * NormalizedRows(poses.BoneWorld(*lead.source)) * toBody;
    // At rest the target is aligned to the axes: left is x, up is y.
    Mat3 wanted = NormalizedRows(targetAtRest);
    if (const std::optional<Vec3> direction = Direction(lead, poses, toBody))
        wanted = wanted * LeastSwing(wanted.Row(1), *direction);
    return AngleBetweenRotations(turned, wanted);
}

bool HasLimbs(const CBodyMap& body)
{
    return std::ranges::all_of(
        kBodySides, [&](EBodySide side) { return body.Arm(side).upperArm && body.Leg(side).thigh; });
}

} // namespace

std::vector<RowTurn> MeasureTurns(const CRetargeter& table, const CNodeNames& targets, const CBodyMap& body,
                                  const BodyStance& rest, CRestWorlds& worlds)
{
    if (!HasLimbs(body))
        return {};
    CBodyPoses poses(body, rest, worlds);
    const std::vector<Lead> leads = FindLeads(table, targets);
    std::vector<RowTurn> turns;
    for (const Lead& lead : leads)
    {
        turns.push_back({lead.target, 0.0});
        poses.Watch(lead.source);
        for (CNode* node : lead.next)
            poses.Watch(node);
    }
    for (size_t pose = 0; pose < poses.Count(); ++pose)
    {
        poses.Take(pose);
        const Mat3 toBody = Mat3Transpose(poses.Axes());
        for (size_t i = 0; i < leads.size(); ++i)
            turns[i].degrees += Turn(leads[i], table, poses, worlds.Of(*leads[i].target), toBody) /
                                static_cast<double>(poses.Count());
    }
    return turns;
}

} // namespace gw
