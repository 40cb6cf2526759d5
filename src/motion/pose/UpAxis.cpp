// A file does not state which of its axes is up. The rest pose may show it, if it is a standing pose, but the
// motion may be rotated relative to it. The trunk's mean direction over the motion shows it if the body
// stands most of the time. If the body is upside down for part of the motion, as in a cartwheel, that mean is
// short. Then the frames decide in which both trunk and legs are along one axis, provided that few are along
// +Y.
//
// If the rest pose stands along +Y and the motion is along another axis, the body may as well lie on the
// ground. It does not if its feet are on the plane through the origin. In a recording whose floor is
// somewhere else, it does not if it walks: the hips of a lying body do not get far while a foot stays in
// place.

#include "UpAxis.h"

#include "BodyPose.h"
#include "BodyStance.h"
#include "CPoseSampler.h"
#include "Directions.h"

#include <algorithm>
#include <array>
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
// Stricter limits for a motion whose zero pose stands along Y: the same minimum, for the mean of trunk and
// legs, and the largest distance of the mean foot position from height 0, in leg lengths. The feet of a body
// that lies on the ground are not near the plane through the origin.
constexpr double kSurelyUpright = 0.9;
constexpr double kNearFloor = 0.25;
// For a body that walks: the seconds between two positions of a joint, the largest movement of a foot that
// stays in place and the smallest of the hips, as shares of the hips' movement and of a leg, and the minimum
// share of such frames. The hips must get half a leg away.
constexpr double kStepSeconds = 0.1;
constexpr double kStaying = 0.25;
constexpr double kMoving = 0.03;
constexpr double kWalkingShare = 0.15;
constexpr double kWalkingReach = 0.5;
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

bool HasTrunkAlong(const Vec3& axis, const Bearing& bearing)
{
    return Vec3Dot(axis, bearing.trunk) >= kUpright;
}

bool StandsAlong(const Vec3& axis, const Bearing& bearing)
{
    return HasTrunkAlong(axis, bearing) && Vec3Dot(axis, bearing.legs) >= kUpright;
}

bool IsSurelyAlong(const Vec3& axis, const Bearing& bearing)
{
    return StandsAlong(axis, bearing) && Vec3Dot(axis, bearing.trunk + bearing.legs) * 0.5 >= kSurelyUpright;
}

bool SurelyStandsAlong(const Vec3& axis, const Bearing& bearing)
{
    return IsSurelyAlong(axis, bearing) && std::fabs(Vec3Dot(axis, bearing.feet)) <= kNearFloor;
}

// Where hips and feet are at a time. A missing foot is at the hips, so it never stays behind.
using Places = std::array<Vec3, 3>;

Places PlacesOf(const CBodyMap& body)
{
    Places places;
    places.fill(PlaceOf(*body.hip));
    for (const EBodySide side : kBodySides)
    {
        if (const CNode* const foot = body.Leg(side).foot)
            places[1 + static_cast<size_t>(side)] = PlaceOf(*foot);
    }
    return places;
}

// Returns whether the body moves along the plane perpendicular to an axis while one of its feet stays.
bool WalksAcross(const Vec3& axis, const CBodyMap& body, float frequency, int frameCount)
{
    const double leg = LegLength(body);
    CPoseSampler sampler(frequency);
    for (CNode* joint : {body.hip, body.Leg(EBodySide::Left).foot, body.Leg(EBodySide::Right).foot})
        sampler.Watch(joint);
    const double step = IsFrameTime(frequency) ? std::max(1.0, std::round(kStepSeconds / frequency)) : 1.0;
    const int count = std::min(frameCount, kSamples);
    int walking = 0;
    double reach = 0.0;
    Vec3 start = kVec3Zero;
    for (int i = 0; i < count; ++i)
    {
        const double frame = static_cast<double>(frameCount) * i / count;
        sampler.Pose(frame);
        const Places from = PlacesOf(body);
        sampler.Pose(frame + step);
        const Places to = PlacesOf(body);
        start = i == 0 ? from[0] : start;
        reach = std::max<double>(reach, Vec3Length(Across(from[0] - start, axis)));
        const double hips = Vec3Length(Across(to[0] - from[0], axis));
        const double foot = std::min(Vec3Length(to[1] - from[1]), Vec3Length(to[2] - from[2]));
        walking += hips >= kMoving * leg && foot <= kStaying * hips ? 1 : 0;
    }
    return reach >= kWalkingReach * leg && walking >= kWalkingShare * count;
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
    if (restUp != kVec3UnitY ? HasTrunkAlong(axis, mean) : SurelyStandsAlong(axis, mean))
        return axis;
    if (axis != kVec3UnitY && IsSurelyAlong(axis, mean) && WalksAcross(axis, body, frequency, frameCount))
        return axis;
    return FindAxisOfTumbling(bearings, restUp);
}

} // namespace gw
