// A file does not state which of its axes is up. The rest pose may show it, if it is a standing pose, but the
// motion may be rotated relative to it. The trunk's mean direction over the motion shows it if the body
// stands most of the time. If the body is upside down for part of the motion, as in a cartwheel, that mean is
// short. Then the frames decide in which both trunk and legs are along one axis, provided that few are along
// +Y.

#include "UpAxis.h"

#include "BodyPose.h"
#include "BodyStance.h"
#include "CPoseSampler.h"
#include "Directions.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <iterator>
#include <vector>

namespace gw {

namespace {

constexpr int kSamples = 64;
// Minimum component of the trunk's mean direction along the axis: the cosine of the largest lean. If the body
// tumbles, the mean is shorter than a unit vector and fails this too.
constexpr double kUpright = 0.8;
// Stricter limits for a motion whose zero pose stands along Y: the same minimum, for trunk and legs, and the
// largest distance of the mean foot position from height 0, in leg lengths. The feet of a body that lies on
// the ground are not near the plane through the origin.
constexpr double kSurelyUpright = 0.9;
constexpr double kNearFloor = 0.25;
// For a body that tumbles: the minimum share of frames that stand along the axis, and how many times as many
// they must be as those along +Y.
constexpr double kTumblingShare = 0.2;
constexpr double kTumblingMore = 3.0;

constexpr Vec3 kAxes[] = {
    kVec3UnitY, {0.0f,  -1.0f, 0.0f },
     kVec3UnitZ, {0.0f,  0.0f,  -1.0f},
     kVec3UnitX, {-1.0f, 0.0f,  0.0f },
};

/// What a pose shows about the up axis, or the mean over several poses.
struct Bearing
{
    Vec3 trunk = kVec3Zero; ///< unit vector; shorter in a mean
    Vec3 legs = kVec3Zero;  ///< mean of the unit vectors from ankle to thigh
    Vec3 feet = kVec3Zero;  ///< midpoint of the feet, in leg lengths
};

Bearing BearingOf(const CBodyMap& body)
{
    const double leg = LegLength(body);
    Bearing bearing{Vec3Normalized(WayTo(body.hip, TrunkTop(body)))};
    for (const BodyLeg& side : body.legs)
    {
        const CNode* const foot = side.foot ? side.foot : side.shin;
        if (!foot || !(leg > 0.0))
            continue;
        bearing.legs = bearing.legs + Vec3Normalized(WayTo(foot, side.thigh)) * 0.5f;
        bearing.feet = bearing.feet + PlaceOf(*foot) * (0.5f / static_cast<float>(leg));
    }
    if (bearing.trunk == kVec3Zero) // a body that consists of legs only
        bearing.trunk = Vec3Normalized(bearing.legs);
    return bearing;
}

std::vector<Bearing> FindBearings(const CBodyMap& body, float frequency, int frameCount)
{
    CPoseSampler sampler(frequency);
    sampler.Watch(body.hip);
    sampler.Watch(TrunkTop(body));
    for (const BodyLeg& leg : body.legs)
    {
        for (CNode* joint : {leg.thigh, leg.shin, leg.foot})
            sampler.Watch(joint);
    }
    const int count = std::min(frameCount, kSamples);
    std::vector<Bearing> bearings;
    for (int i = 0; i < count; ++i)
    {
        sampler.Pose(static_cast<int>(static_cast<int64_t>(frameCount) * i / count));
        bearings.push_back(BearingOf(body));
    }
    return bearings;
}

Bearing MeanOf(const std::vector<Bearing>& bearings)
{
    Bearing mean;
    const float weight = 1.0f / static_cast<float>(std::max<size_t>(bearings.size(), 1));
    for (const Bearing& bearing : bearings)
    {
        mean.trunk = mean.trunk + bearing.trunk * weight;
        mean.legs = mean.legs + bearing.legs * weight;
        mean.feet = mean.feet + bearing.feet * weight;
    }
    return mean;
}

bool SurelyStandsAlong(const Vec3& axis, const Bearing& bearing)
{
    return Vec3Dot(axis, bearing.trunk) >= kSurelyUpright && Vec3Dot(axis, bearing.legs) >= kSurelyUpright &&
           std::fabs(Vec3Dot(axis, bearing.feet)) <= kNearFloor;
}

bool HasTrunkAlong(const Vec3& axis, const Bearing& bearing)
{
    return Vec3Dot(axis, bearing.trunk) >= kUpright;
}

bool StandsAlong(const Vec3& axis, const Bearing& bearing)
{
    return HasTrunkAlong(axis, bearing) && Vec3Dot(axis, bearing.legs) >= kUpright;
}

// Returns the up axis of a body that stands along one axis for part of the motion and tumbles for the rest. A
// rest pose that stands along the same axis is enough evidence; otherwise the feet must be on the floor.
// Returns +Y if there is not enough evidence.
Vec3 FindAxisOfTumbling(const std::vector<Bearing>& bearings, const Vec3& restUp)
{
    const auto countAlong = [&](const Vec3& axis) {
        return std::ranges::count_if(bearings,
                                     [&](const Bearing& bearing) { return StandsAlong(axis, bearing); });
    };
    const Vec3 axis = *std::ranges::max_element(kAxes, {}, countAlong);
    const auto along = static_cast<double>(countAlong(axis));
    if (along < kTumblingShare * static_cast<double>(bearings.size()) ||
        along < kTumblingMore * static_cast<double>(countAlong(kVec3UnitY)))
        return kVec3UnitY;
    std::vector<Bearing> standing;
    std::ranges::copy_if(bearings, std::back_inserter(standing),
                         [&](const Bearing& bearing) { return StandsAlong(axis, bearing); });
    return axis == restUp || SurelyStandsAlong(axis, MeanOf(standing)) ? axis : kVec3UnitY;
}

} // namespace

Vec3 FindUpAxis(const CBodyMap& body, float frequency, int frameCount)
{
    const BodyStance rest = RestStanceOf(body);
    const bool isStance = rest.IsReference() || frameCount <= 0;
    const Vec3 restUp = isStance ? NearestAxis(rest.up) : kVec3Zero;
    const std::vector<Bearing> bearings = FindBearings(body, frequency, frameCount);
    const Bearing mean = MeanOf(bearings);
    if (mean.trunk == kVec3Zero)
        return isStance ? restUp : kVec3UnitY;
    const Vec3 axis = NearestAxis(mean.trunk);
    const bool stands = restUp == kVec3UnitY ? SurelyStandsAlong(axis, mean) : HasTrunkAlong(axis, mean);
    return stands ? axis : FindAxisOfTumbling(bearings, restUp);
}

} // namespace gw
