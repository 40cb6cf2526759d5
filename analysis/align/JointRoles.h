#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <cstdint>
#include <vector>

namespace gw {

class CTreePoser;

/// The body part of a joint. A joint between two of these belongs to the upper one: the twist joint of a
/// thigh is a thigh.
enum class EBodyPart : uint8_t
{
    None, ///< a finger, an eye, a helper: follows its parent
    AboveHip,
    Hip,
    Spine,
    Neck,
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

/// Returns whether a part is one of the two long bones of an arm or leg.
constexpr bool IsLimb(EBodyPart part)
{
    return part == EBodyPart::UpperArm || part == EBodyPart::Forearm || part == EBodyPart::Thigh ||
           part == EBodyPart::Shin;
}

struct JointRole
{
    EBodyPart part = EBodyPart::None;
    EBodySide side = EBodySide::Left; ///< of a limb
    CNode* next = nullptr;            ///< the child along the limb or up the spine, or null
    bool carriesArms = false;         ///< of the trunk: the arms branch off here
};

/// Returns the roles of all joints, in tree order. Joints that are not where they should be in the tree (a
/// forearm that is not below its upper arm) only get their own role.
std::vector<JointRole> FindRoles(const CTreePoser& tree, const CBodyMap& body);

/// Returns whether a part belongs to the spine, including hip and neck.
bool IsTrunk(EBodyPart part);

/// Returns the axis of a part in a T-pose; zero if it has none.
Vec3 AxisOf(const JointRole& role);

} // namespace gw
