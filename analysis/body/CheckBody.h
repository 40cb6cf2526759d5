#pragma once

#include "BodyJoints.h"

#include <cstdint>
#include <vector>

namespace gw {

class CJointTree;

/// What speaks against a joint being what a map of a body says.
enum class EBodyDoubt : uint8_t
{
    NotBelow,      ///< it does not hang from the joint that should carry it
    SidesSwapped,  ///< legs: left is not up x forward; arms: not on the sides of the legs
    ClavicleIsArm, ///< what should be the upper arm lies a joint too far out: the clavicle is one
    ArmIsClavicle, ///< what should be the upper arm is too short: it is the clavicle
    LegsUp,        ///< the legs go the way of the trunk in every pose
    OddLength,     ///< the bones of a limb are not in proportion, or not as long as those of the other side
};

struct BodyDoubt
{
    EBodyDoubt kind = EBodyDoubt::NotBelow;
    BodyPlace place; ///< of the joint concerned; the upper arm or thigh of a limb as a whole
};

/// Doubts about a map of a body by the places of its joints over the rest pose and some frames; names are not
/// looked at. Joints that are not there raise none. The tree is posed meanwhile and left as it was.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body);
/// The same with the skeleton's tree, which was looked at already.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body, const CJointTree& tree);

} // namespace gw
