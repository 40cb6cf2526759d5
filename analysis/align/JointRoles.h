#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <cstdint>
#include <vector>

namespace gw {

class CTreePoser;

/// What a joint is to the body. A joint between two of these has the part of the upper one: the twist joint
/// of a thigh is a thigh.
enum class EBodyPart : uint8_t
{
    None, ///< a finger, an eye, a helper: goes along with its parent
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

struct JointRole
{
    EBodyPart part = EBodyPart::None;
    EBodySide side = EBodySide::Left; ///< of a limb
    CNode* next = nullptr;            ///< the child on the way down the limb or up the spine, or null
    bool carriesArms = false;         ///< of the trunk: where the arms part from the spine
};

/// The roles of all joints of a tree, in its order. Joints of the body that do not hang as they should (a
/// forearm that is not below its upper arm) have their own part alone.
std::vector<JointRole> FindRoles(const CTreePoser& tree, const CBodyMap& body);

/// Whether a part is of the spine, hip and neck included.
bool IsTrunk(EBodyPart part);

/// The axis along which a part lies in the rest pose that suits the rules; zero where it has none.
Vec3 AxisOf(const JointRole& role);

} // namespace gw
