#include "FootTurn.h"

#include "Angles.h"
#include "BodyPose.h"
#include "BodyTree.h"
#include "BoneMeshQueries.h"
#include "CReferencePose.h"
#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kLeastReach = 0.05; // of a leg: a shorter vector does not show the heading
constexpr double kOddNormal = 50.0;  // in degrees: a standing foot is not this far off its stance
// Slope from ankle to toe in a standing foot, in degrees: usual, minimum and maximum.
constexpr double kSlope = 25.0;
constexpr double kLeastSlope = 5.0;
constexpr double kMostSlope = 50.0;

// Returns the possible directions of a foot, from its toe outward.
std::vector<Vec3> WaysAhead(const BodyLeg& leg)
{
    std::vector<Vec3> ways;
    const Vec3 ankle = PlaceOf(*leg.foot);
    const CNode* last = leg.foot;
    for (const CNode* joint = leg.toe ? leg.toe : FirstChild(*leg.foot); joint; joint = FirstChild(*joint))
    {
        ways.push_back(PlaceOf(*joint) - ankle);
        last = joint;
    }
    if (const Vec3 end = NodeBoneEnd(*last); end != kVec3Zero)
        ways.push_back(TransformCoord(end, last->m_kWorldMatrix) - ankle);
    return ways;
}

// Returns the first direction that points ahead, or the body's facing.
Vec3 WayAhead(const BodyLeg& leg, const CReferencePose& pose, const Vec3& up)
{
    for (const Vec3& way : WaysAhead(leg))
    {
        if (Vec3Length(Across(way, up)) >= kLeastReach * pose.legLength)
            return way;
    }
    return pose.facing;
}

// Returns the normal of a sole if only the direction to the toe is known.
Vec3 NormalBySlope(const Vec3& way, const CReferencePose& pose)
{
    const Vec3 ahead = Vec3Normalized(way);
    const Vec3 left = Turned(kVec3UnitX, Mat3Transpose(pose.hips));
    const Vec3 above = Vec3Normalized(Vec3Cross(ahead, Across(left, ahead)));
    const double slope = kSlope * kDegreesToRadians64;
    return above * static_cast<float>(std::cos(slope)) - ahead * static_cast<float>(std::sin(slope));
}

Vec3 PosedNormal(const BodyLeg& leg, const CReferencePose& pose, bool isLevel)
{
    const Vec3 way = WayAhead(leg, pose, pose.up);
    const double slope = AngleBetween(way, pose.up) - 90.0;
    if (isLevel || way == pose.facing || (slope >= kLeastSlope && slope <= kMostSlope))
        return pose.up;
    return NormalBySlope(way, pose);
}

} // namespace

Mat3 FootTurn(const BodyLeg& leg, const CReferencePose& pose, const std::optional<Vec3>& standing,
              bool isLevel)
{
    const Vec3 posed = PosedNormal(leg, pose, isLevel);
    Vec3 normal = LocalDirection(posed, *leg.foot);
    if (standing && AngleBetween(*standing, normal) < kOddNormal)
        normal = *standing;
    const Vec3 heading = LocalDirection(WayAhead(leg, pose, posed), *leg.foot);
    return TurnUpright(normal, Vec3Cross(normal, heading));
}

} // namespace gw
