#include "MotionFacts.h"

#include "Angles.h"
#include "CPoseSampler.h"
#include "Vec3.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

struct UnitRow
{
    std::string_view name;
    double shortest; // leg, of a child
    double longest;  // of a tall adult
};

constexpr UnitRow kUnits[] = {
    {"metres",          0.4,   1.1   },
    {"decimetres",      5.0,   11.0  },
    {"units of 5.6 cm", 12.0,  18.0  }, // of a large university's archive
    {"inches",          20.0,  42.0  },
    {"centimetres",     45.0,  110.0 },
    {"millimetres",     450.0, 1100.0},
};

constexpr std::string_view kRestPoseNames[] = {"unknown", "none", "T-pose", "A-pose", "arms down", "other"};
constexpr std::string_view kBodySourceNames[] = {"none", "names", "shape"};

// Degrees. In T-poses of real files an arm is 6 off the line through both shoulders at the most, in all other
// rest poses 43 or more.
constexpr double kMostOfTPose = 32.0;
constexpr double kMostOfAPose = 65.0;
constexpr double kMostOfArmsDown = 30.0; // from the direction of the legs
constexpr double kMostOfStance = 60.0;   // of the legs from straight down, as the torso has it

Vec3 RestPlace(const CNode& node)
{
    return RestWorld(node).Translation();
}

double DegreesBetween(const Vec3& a, const Vec3& b)
{
    return std::atan2(Vec3Length(Vec3Cross(a, b)), Vec3Dot(a, b)) / kDegreesToRadians64;
}

bool HasLimbs(const CBodyMap& body)
{
    const auto armIsThere = [](const BodyArm& arm) { return arm.upperArm && arm.hand; };
    const auto legIsThere = [](const BodyLeg& leg) { return leg.thigh && leg.foot; };
    return body.head && std::ranges::all_of(body.arms, armIsThere) &&
           std::ranges::all_of(body.legs, legIsThere);
}

Vec3 LegsDirection(const CBodyMap& body)
{
    Vec3 sum = kVec3Zero;
    for (const BodyLeg& leg : body.legs)
        sum = sum + RestPlace(*leg.foot) - RestPlace(*leg.thigh);
    return sum;
}

Vec3 TorsoDirection(const CBodyMap& body)
{
    const Vec3 thighs = RestPlace(*body.legs[0].thigh) + RestPlace(*body.legs[1].thigh);
    return RestPlace(*body.head) - thighs * 0.5f;
}

// The larger of both arms' angles to directions that mirror each other.
template <class Direction>
double ArmsOff(const CBodyMap& body, Direction direction)
{
    double most = 0.0;
    for (const EBodySide side : kBodySides)
    {
        const BodyArm& arm = body.Arm(side);
        most =
            std::max(most, DegreesBetween(RestPlace(*arm.hand) - RestPlace(*arm.upperArm), direction(side)));
    }
    return most;
}

} // namespace

std::string_view UnitOfLeg(double leg)
{
    const auto fits = [=](const UnitRow& row) { return leg >= row.shortest && leg <= row.longest; };
    const auto* const row = std::ranges::find_if(kUnits, fits);
    return row == std::end(kUnits) ? std::string_view() : row->name;
}

ERestPose RestPoseOf(const CBodyMap& body)
{
    if (!HasLimbs(body))
        return ERestPose::Unknown;
    const Vec3 down = LegsDirection(body);
    if (DegreesBetween(down, -TorsoDirection(body)) > kMostOfStance)
        return ERestPose::None;
    const Vec3 left = RestPlace(*body.arms[0].upperArm) - RestPlace(*body.arms[1].upperArm);
    const double fromSides =
        ArmsOff(body, [&](EBodySide side) { return side == EBodySide::Left ? left : -left; });
    if (fromSides <= kMostOfTPose)
        return ERestPose::TPose;
    if (ArmsOff(body, [&](EBodySide) { return down; }) <= kMostOfArmsDown)
        return ERestPose::ArmsDown;
    return fromSides <= kMostOfAPose ? ERestPose::APose : ERestPose::Other;
}

std::string_view RestPoseName(ERestPose pose)
{
    return kRestPoseNames[static_cast<size_t>(pose)];
}

std::string_view BodySourceName(EBodySource source)
{
    return kBodySourceNames[static_cast<size_t>(source)];
}

} // namespace gw
