// A file does not say which of its axes is up. Its rest pose may, if it is a stance, but the motion may be
// turned against it. The trunk's mean direction over the motion does, if the body stands on the whole. A body
// that is upside down for part of the motion, as in a cartwheel, has a short mean; then the frames decide in
// which trunk and legs stand along one axis, if next to none do so along +Y.

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
// Cosine of the angle by which the trunk's mean direction may lean from the axis; a mean over figures that
// tumble is shorter.
constexpr double kUpright = 0.8;
// The same for trunk and legs of a motion whose zero pose stands along Y, and how far from height 0, in leg
// lengths, its feet may be on the whole: who lies on the ground does not stand on the origin's plane.
constexpr double kSurelyUpright = 0.9;
constexpr double kNearFloor = 0.25;
// Of the frames, how many stand along the axis of a body that tumbles; and how many times as many as along
// +Y.
constexpr double kTumblingShare = 0.2;
constexpr double kTumblingMore = 3.0;

constexpr Vec3 kAxes[] = {
    kVec3UnitY, {0.0f,  -1.0f, 0.0f },
     kVec3UnitZ, {0.0f,  0.0f,  -1.0f},
     kVec3UnitX, {-1.0f, 0.0f,  0.0f },
};

/// What a pose shows of the up axis, or the mean of several.
struct Bearing
{
    Vec3 trunk = kVec3Zero; ///< unit vector
    Vec3 legs = kVec3Zero;  ///< the mean of unit vectors from ankle to thigh
    Vec3 feet = kVec3Zero;  ///< their middle, in leg lengths
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
    if (bearing.trunk == kVec3Zero) // a body of legs
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

// The axis of a body that stands along one for part of the motion, and is tumbling for the rest. A rest pose
// that stands along it too is evidence enough; without one the feet have to be on the floor.
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
