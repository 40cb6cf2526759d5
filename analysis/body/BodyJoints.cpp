#include "BodyJoints.h"

#include <algorithm>

namespace gw {

namespace {

using enum EBodyJoint;
using enum EBodySide;

constexpr std::array<BodyPlace, kBodyPlaceCount> kPlaces{
    {
     {Hip, Left}, {Spine, Left}, {Neck, Left}, {Head, Left}, {Clavicle, Left},
     {UpperArm, Left}, {Forearm, Left}, {Hand, Left}, {Clavicle, Right}, {UpperArm, Right},
     {Forearm, Right}, {Hand, Right}, {Thigh, Left}, {Shin, Left}, {Foot, Left},
     {Toe, Left}, {Thigh, Right}, {Shin, Right}, {Foot, Right}, {Toe, Right},
     }
};

constexpr EBodyJoint kOptional[] = {Neck, Clavicle, Foot, Toe};

} // namespace

const std::array<BodyPlace, kBodyPlaceCount>& BodyPlaces()
{
    return kPlaces;
}

size_t IndexOf(BodyPlace place)
{
    if (!HasSides(place.joint))
        place.side = Left;
    return static_cast<size_t>(std::ranges::find(kPlaces, place) - kPlaces.begin());
}

CNode* JointAt(const CBodyMap& body, BodyPlace place)
{
    const BodyArm& arm = body.Arm(place.side);
    const BodyLeg& leg = body.Leg(place.side);
    switch (place.joint)
    {
    case Hip:
        return body.hip;
    case Spine:
        return body.spine.empty() ? nullptr : body.spine.back();
    case Neck:
        return body.neck.empty() ? nullptr : body.neck.front();
    case Head:
        return body.head;
    case Clavicle:
        return arm.clavicle;
    case UpperArm:
        return arm.upperArm;
    case Forearm:
        return arm.forearm;
    case Hand:
        return arm.hand;
    case Thigh:
        return leg.thigh;
    case Shin:
        return leg.shin;
    case Foot:
        return leg.foot;
    case Toe:
        return leg.toe;
    }
    return nullptr;
}

bool HasSides(EBodyJoint joint)
{
    return joint >= Clavicle;
}

bool IsNeeded(EBodyJoint joint)
{
    return std::ranges::find(kOptional, joint) == std::end(kOptional);
}

} // namespace gw
