#include "WorldUp.h"

#include "Alignment.h"
#include "BodyPose.h"
#include "CPoseSampler.h"
#include "Directions.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace gw {

namespace {

constexpr int kSamples = 64;
// Cosine of the angle by which the trunk's mean direction may lean from the axis; a mean over figures that
// tumble is shorter.
constexpr double kUpright = 0.8;
// The same for trunk and legs of a motion whose zero pose stands along Y, and how far from height 0, in leg
// lengths, its feet may be on the whole: who lies on the ground does not stand on the origin's plane.
constexpr double kSurelyUpright = 0.9;
constexpr double kNearFloor = 0.25;

/// What a motion shows of its up axis: means over some of its frames.
struct Bearing
{
    Vec3 trunk = kVec3Zero; ///< of unit vectors
    Vec3 legs = kVec3Zero;  ///< the same, from ankle to thigh
    Vec3 feet = kVec3Zero;  ///< places in leg lengths
};

void AddPose(const CBodyMap& body, float weight, Bearing& bearing)
{
    const double leg = LegLength(body);
    bearing.trunk = bearing.trunk + Vec3Normalized(WayTo(body.hip, TrunkTop(body))) * weight;
    for (const BodyLeg& side : body.legs)
    {
        const CNode* const foot = side.foot ? side.foot : side.shin;
        if (!foot || !(leg > 0.0))
            continue;
        bearing.legs = bearing.legs + Vec3Normalized(WayTo(foot, side.thigh)) * (weight / 2);
        bearing.feet = bearing.feet + PlaceOf(*foot) * (weight / 2 / static_cast<float>(leg));
    }
}

Bearing FindBearing(const BodyMotion& motion)
{
    CPoseSampler sampler(motion.frequency);
    sampler.Watch(motion.body.hip);
    sampler.Watch(TrunkTop(motion.body));
    for (const BodyLeg& leg : motion.body.legs)
    {
        for (CNode* joint : {leg.thigh, leg.shin, leg.foot})
            sampler.Watch(joint);
    }
    const int count = std::min(motion.frameCount, kSamples);
    Bearing bearing;
    for (int i = 0; i < count; ++i)
    {
        sampler.Pose(static_cast<int>(static_cast<int64_t>(motion.frameCount) * i / count));
        AddPose(motion.body, 1.0f / static_cast<float>(count), bearing);
    }
    return bearing;
}

bool SurelyStandsAlong(const Vec3& axis, const Bearing& bearing)
{
    return Vec3Dot(axis, bearing.trunk) >= kSurelyUpright && Vec3Dot(axis, bearing.legs) >= kSurelyUpright &&
           std::fabs(Vec3Dot(axis, bearing.feet)) <= kNearFloor;
}

} // namespace

Vec3 FindWorldUp(const BodyMotion& motion, const std::optional<Vec3>& restUp)
{
    const Bearing bearing = FindBearing(motion);
    if (bearing.trunk == kVec3Zero)
        return restUp.value_or(kVec3UnitY);
    const Vec3 axis = NearestAxis(bearing.trunk);
    const bool stands =
        restUp == kVec3UnitY ? SurelyStandsAlong(axis, bearing) : Vec3Dot(axis, bearing.trunk) >= kUpright;
    return stands ? axis : kVec3UnitY;
}

} // namespace gw
