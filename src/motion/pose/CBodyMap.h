#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

class CNode;

/// A side of the body, from the body's own point of view.
enum class EBodySide : uint8_t
{
    Left,
    Right,
};
inline constexpr std::array kBodySides{EBodySide::Left, EBodySide::Right};

/// The joints of one arm; each rotates the bone below it. Null if the skeleton lacks it.
struct BodyArm
{
    CNode* clavicle = nullptr;
    CNode* upperArm = nullptr;
    CNode* forearm = nullptr;
    CNode* hand = nullptr;

    friend bool operator==(const BodyArm&, const BodyArm&) = default;
};

/// The joints of one leg; each rotates the bone below it. Null if the skeleton lacks it.
struct BodyLeg
{
    CNode* thigh = nullptr;
    CNode* shin = nullptr;
    CNode* foot = nullptr; ///< the ankle
    CNode* toe = nullptr;  ///< the ball of the foot

    friend bool operator==(const BodyLeg&, const BodyLeg&) = default;
};

/// The joints of a skeleton that belong to a human body. The nodes are not kept alive.
struct CBodyMap
{
    CNode* hip = nullptr;      ///< the joint that carries the body's motion, where legs and spine meet
    std::vector<CNode*> spine; ///< from the pelvis upward, without hip and neck
    std::vector<CNode*> neck;  ///< upward, without the head
    CNode* head = nullptr;
    std::array<BodyArm, 2> arms; ///< by EBodySide
    std::array<BodyLeg, 2> legs;

    BodyArm& Arm(EBodySide side) { return arms[static_cast<size_t>(side)]; }
    const BodyArm& Arm(EBodySide side) const { return arms[static_cast<size_t>(side)]; }
    BodyLeg& Leg(EBodySide side) { return legs[static_cast<size_t>(side)]; }
    const BodyLeg& Leg(EBodySide side) const { return legs[static_cast<size_t>(side)]; }

    /// Returns whether the thirteen joints that drive a whole body are present: hip, a spine joint, head, and
    /// on each side upper arm, forearm, hand, thigh and shin.
    bool DrivesBody() const;
    /// Returns whether DrivesBody holds and both feet are present, without which no foot can be planted.
    bool HasFeet() const;

    friend bool operator==(const CBodyMap&, const CBodyMap&) = default;
};

} // namespace gw
