#pragma once

#include "CBodyMap.h"

#include <array>
#include <cstdint>

namespace gw {

/// The role of a joint in a human body.
enum class EBodyJoint : uint8_t
{
    Hip,
    Spine, ///< the highest of several, which carries the arms
    Neck,  ///< the lowest of several
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

/// A joint of a body. The side is unused for joints of the trunk.
struct BodyPlace
{
    EBodyJoint joint = EBodyJoint::Hip;
    EBodySide side = EBodySide::Left;

    friend bool operator==(const BodyPlace&, const BodyPlace&) = default;
};

inline constexpr size_t kBodyPlaceCount = 20;

/// Returns all places of a body: from the hip upward, then arms and legs, left before right.
const std::array<BodyPlace, kBodyPlaceCount>& BodyPlaces();
/// Returns the index of a place in BodyPlaces().
size_t IndexOf(BodyPlace place);

/// Returns the joint at a place, or null.
CNode* JointAt(const CBodyMap& body, BodyPlace place);
/// Returns whether the joint belongs to an arm or a leg, so that there are two of it.
bool HasSides(EBodyJoint joint);
/// Returns whether a body cannot be driven without it: one of the thirteen required joints.
bool IsNeeded(EBodyJoint joint);

} // namespace gw
