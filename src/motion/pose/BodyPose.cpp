#include "BodyPose.h"

#include "Directions.h"

#include <algorithm>

namespace gw {

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

} // namespace gw
