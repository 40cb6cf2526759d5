// Judges a rest pose only by the body's own axes and the directions between joints. The world's up axis, the
// orientation of the bones and their lengths differ between files and say nothing about the stance.

#include "BodyStance.h"

#include "CPoseSampler.h"
#include "Directions.h"

#include <algorithm>
#include <array>

namespace gw {

namespace {

// Degrees. In T-poses of real files, an arm is at most 6 off the shoulder line; in all other rest poses, at
// least 43.
constexpr double kMostOfTPose = 32.0;
constexpr double kMostOfAPose = 65.0;
constexpr double kMostOfArmsDown = 30.0;
// Spread legs are up to 20 off; in rest poses that are not stances, legs lie along the trunk.
constexpr double kMostOfStance = 45.0;

// Transforms a point up the tree, which is cheaper than multiplying matrices.
Vec3 RestPlace(const CNode& joint)
{
    Vec3 place = RestLocal(joint).Translation();
    for (const CNode* parent = joint.GetParentNode(); parent; parent = parent->GetParentNode())
        place = TransformCoord(place, RestLocal(*parent));
    return place;
}

constexpr std::string_view kRestPoseNames[] = {"unknown", "none", "T-pose", "A-pose", "arms down", "other"};

using Angle = std::optional<double>;
using Ways = std::array<Vec3, 2>; // by EBodySide; zero if a joint is missing

Angle Between(const Vec3& a, const Vec3& b)
{
    return a == kVec3Zero || b == kVec3Zero ? std::nullopt : Angle(AngleBetween(a, b));
}

Angle Larger(const Ways& ways, const Vec3& left, const Vec3& right)
{
    const Angle a = Between(ways[0], left);
    const Angle b = Between(ways[1], right);
    return a && b ? std::max(a, b) : std::nullopt;
}

// The angle of a foot from `forward`. 0 if the toe is missing or below the ankle.
double FootOff(const Vec3& foot, const BodyStance& stance)
{
    constexpr double kAhead = 0.5; // sine of the angle from the trunk
    const Vec3 ahead = Across(foot, stance.up);
    return Vec3Length(ahead) <= kAhead * Vec3Length(foot) ? 0.0 : AngleBetween(ahead, stance.forward);
}

} // namespace

ERestPose BodyStance::Verdict() const
{
    if (!armsSide)
        return ERestPose::Unknown;
    if (thighs && !Stands())
        return ERestPose::None;
    if (*armsSide <= kMostOfTPose)
        return ERestPose::TPose;
    if (armsDown && *armsDown <= kMostOfArmsDown)
        return ERestPose::ArmsDown;
    return *armsSide <= kMostOfAPose ? ERestPose::APose : ERestPose::Other;
}

// Limits in degrees: an A-pose spreads its legs by 20, and joints lie beside the bones' real ends.
bool BodyStance::IsReference() const
{
    constexpr double kTrunkLimit = 40.0;
    constexpr double kLegLimit = 40.0;
    constexpr double kShoulderLimit = 35.0;
    constexpr double kFootLimit = 70.0;
    return left != kVec3Zero && AngleBetween(up, NearestAxis(up)) < kTrunkLimit &&
           thighs.value_or(180.0) < kLegLimit && shins.value_or(180.0) < kLegLimit &&
           shoulders.value_or(0.0) < kShoulderLimit && feet < kFootLimit;
}

bool BodyStance::Stands() const
{
    return thighs && *thighs <= kMostOfStance;
}

BodyStance StanceOf(const CBodyMap& body, const JointPlaces& places)
{
    const auto way = [&](const CNode* from, const CNode* to) {
        return from && to ? places(*to) - places(*from) : kVec3Zero;
    };
    const auto ofLegs = [&](CNode* BodyLeg::*from, CNode* BodyLeg::*to) {
        return Ways{way(body.legs[0].*from, body.legs[0].*to), way(body.legs[1].*from, body.legs[1].*to)};
    };
    const auto ofArm = [&](const BodyArm& arm) {
        return way(arm.upperArm, arm.hand ? arm.hand : arm.forearm);
    };
    const CNode* const chest = body.spine.empty() ? nullptr : body.spine.back();
    const Vec3 shoulders = way(body.arms[1].upperArm, body.arms[0].upperArm);
    const Ways arms{ofArm(body.arms[0]), ofArm(body.arms[1])};
    const Ways thighs = ofLegs(&BodyLeg::thigh, &BodyLeg::shin);
    const Ways feet = ofLegs(&BodyLeg::foot, &BodyLeg::toe);
    BodyStance stance;
    stance.up = Vec3Normalized(way(body.hip, body.head ? body.head : chest));
    stance.left = Vec3Normalized(Across(way(body.legs[1].thigh, body.legs[0].thigh), stance.up));
    stance.forward = Vec3Cross(stance.left, stance.up);
    const Vec3 down = -stance.up;
    stance.thighs = Larger(thighs, down, down);
    stance.apart = Between(thighs[0], thighs[1]);
    stance.shins = Larger(ofLegs(&BodyLeg::shin, &BodyLeg::foot), down, down);
    stance.feet = std::max(FootOff(feet[0], stance), FootOff(feet[1], stance));
    stance.shoulders = Between(shoulders, stance.left);
    stance.armsSide = Larger(arms, shoulders, -shoulders);
    stance.armsDown = Larger(arms, down, down);
    return stance;
}

BodyStance RestStanceOf(const CBodyMap& body)
{
    return StanceOf(body, RestPlace);
}

std::string_view RestPoseName(ERestPose pose)
{
    return kRestPoseNames[static_cast<size_t>(pose)];
}

} // namespace gw
