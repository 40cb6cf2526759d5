#include "BodyPose.h"

#include "Turns.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Limits of a stance in degrees. An A-pose spreads its legs by 20; joints lie beside the bones' real ends.
constexpr double kTrunkLimit = 40.0;
constexpr double kLegLimit = 40.0;
constexpr double kShoulderLimit = 35.0;
constexpr double kFootLimit = 70.0;

// What the parts of a body weigh when a reference pose is looked for.
constexpr double kFootWeight = 0.5;
constexpr double kElbowWeight = 0.3;
constexpr double kArmWeight = 0.2;

class CWeighedError
{
public:
    void Add(double degrees, double weight = 1.0)
    {
        m_fSum += weight * degrees * degrees;
        m_fWeight += weight;
    }
    double Mean() const { return m_fWeight > 0.0 ? std::sqrt(m_fSum / m_fWeight) : 0.0; }

private:
    double m_fSum = 0.0;
    double m_fWeight = 0.0;
};

void AddArm(const BodyArm& arm, const Vec3& up, const Vec3& sideways, CWeighedError& error)
{
    if (!arm.upperArm || !arm.forearm)
        return;
    const Vec3 upper = WayTo(arm.upperArm, arm.forearm);
    error.Add(std::min(AngleBetween(upper, -up), AngleBetween(upper, sideways)), kArmWeight);
    if (arm.hand)
        error.Add(AngleBetween(upper, WayTo(arm.forearm, arm.hand)), kElbowWeight);
}

bool IsLegDown(const BodyLeg& leg, const Vec3& up)
{
    return AngleBetween(WayTo(leg.thigh, leg.shin), -up) < kLegLimit &&
           AngleBetween(WayTo(leg.shin, leg.foot), -up) < kLegLimit;
}

// Whether a foot whose toe lies ahead lies along the facing.
bool FacesWith(const BodyLeg& leg, const Vec3& up, const Vec3& facing)
{
    const Vec3 way = WayTo(leg.foot, leg.toe);
    const Vec3 ahead = Across(way, up);
    return Vec3Length(ahead) < 0.5 * Vec3Length(way) || AngleBetween(ahead, facing) < kFootLimit;
}

} // namespace

Vec3 WayTo(const CNode* from, const CNode* to)
{
    return from && to ? PlaceOf(*to) - PlaceOf(*from) : kVec3Zero;
}

Vec3 LocalDirection(const Vec3& direction, const CNode& node)
{
    return Turned(direction, Mat3Transpose(NormalizedRows(node.m_kWorldMatrix)));
}

Vec3 HipLine(const CBodyMap& body)
{
    return WayTo(body.Leg(EBodySide::Right).thigh, body.Leg(EBodySide::Left).thigh);
}

Vec3 ShoulderLine(const CBodyMap& body)
{
    return WayTo(body.Arm(EBodySide::Right).upperArm, body.Arm(EBodySide::Left).upperArm);
}

CNode* TrunkTop(const CBodyMap& body)
{
    if (!body.neck.empty())
        return body.neck.front();
    if (body.head)
        return body.head;
    return body.spine.empty() ? nullptr : body.spine.back();
}

double LegLength(const CBodyMap& body)
{
    double longest = 0.0;
    for (const BodyLeg& leg : body.legs)
        longest =
            std::max(longest, Vec3Length(WayTo(leg.thigh, leg.shin)) + Vec3Length(WayTo(leg.shin, leg.foot)));
    return longest;
}

double StanceError(const CBodyMap& body, const Vec3& up)
{
    CWeighedError error;
    const Vec3 left = Across(HipLine(body), up);
    const Vec3 facing = Vec3Cross(left, up);
    error.Add(AngleBetween(WayTo(body.hip, TrunkTop(body)), up));
    if (const Vec3 shoulders = ShoulderLine(body); shoulders != kVec3Zero)
        error.Add(AngleBetween(shoulders, left));
    for (const EBodySide side : kBodySides)
    {
        const BodyLeg& leg = body.Leg(side);
        error.Add(AngleBetween(WayTo(leg.thigh, leg.shin), -up));
        error.Add(AngleBetween(WayTo(leg.shin, leg.foot), -up));
        if (const Vec3 ahead = Across(WayTo(leg.foot, leg.toe), up); ahead != kVec3Zero)
            error.Add(AngleBetween(ahead, facing), kFootWeight);
        AddArm(body.Arm(side), up, side == EBodySide::Left ? left : -left, error);
    }
    return error.Mean();
}

bool FindStance(const CBodyMap& body, Vec3& up)
{
    const Vec3 trunk = WayTo(body.hip, TrunkTop(body));
    Vec3 legs = kVec3Zero;
    for (const BodyLeg& leg : body.legs)
        legs = legs + WayTo(leg.foot ? leg.foot : leg.shin, leg.thigh);
    up = NearestAxis(Vec3Normalized(trunk) + Vec3Normalized(legs));
    const Vec3 left = Across(HipLine(body), up);
    const Vec3 facing = Vec3Cross(left, up);
    const Vec3 shoulders = ShoulderLine(body);
    return left != kVec3Zero && AngleBetween(trunk, up) < kTrunkLimit &&
           (shoulders == kVec3Zero || AngleBetween(shoulders, left) < kShoulderLimit) &&
           std::ranges::all_of(body.legs, [&](const BodyLeg& leg) {
               return IsLegDown(leg, up) && FacesWith(leg, up, facing);
           });
}

Vec3 NearestAxis(const Vec3& direction)
{
    Vec3 nearest = kVec3UnitY;
    for (const Vec3& axis : {kVec3UnitX, kVec3UnitY, kVec3UnitZ, -kVec3UnitX, -kVec3UnitY, -kVec3UnitZ})
    {
        if (Vec3Dot(axis, direction) > Vec3Dot(nearest, direction))
            nearest = axis;
    }
    return nearest;
}

} // namespace gw
