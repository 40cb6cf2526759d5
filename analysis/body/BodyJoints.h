#pragma once

#include "CBodyMap.h"

#include <array>
#include <cstdint>

namespace gw {

/// What a joint is in a human body.
enum class EBodyJoint : uint8_t
{
    Hip,
    Spine, ///< of several the highest, which carries the arms
    Neck,  ///< of several the lowest
    Head,
    Clavicle,
    UpperArm,
    Forearm,
    Hand,
    Thigh,
    Shin,
    Foot,
    Toe,
};

/// One joint of a body. The side has no meaning for a joint of the trunk.
struct BodyPlace
{
    EBodyJoint joint = EBodyJoint::Hip;
    EBodySide side = EBodySide::Left;

    friend bool operator==(const BodyPlace&, const BodyPlace&) = default;
};

inline constexpr size_t kBodyPlaceCount = 20;

/// All places of a body, from the hip upward, then arms and legs, the left one first.
const std::array<BodyPlace, kBodyPlaceCount>& BodyPlaces();
/// The index of a place in BodyPlaces().
size_t IndexOf(BodyPlace place);

/// The joint at a place, or null.
CNode* JointAt(const CBodyMap& body, BodyPlace place);
/// Whether an arm or a leg holds the joint, so that there are two of it.
bool HasSides(EBodyJoint joint);
/// Whether a body cannot be driven without it: one of the thirteen.
bool IsNeeded(EBodyJoint joint);

} // namespace gw
