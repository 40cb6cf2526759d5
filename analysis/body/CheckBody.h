#pragma once

#include "BodyJoints.h"

#include <cstdint>
#include <vector>

namespace gw {

class CJointTree;

/// A reason why a joint may not be what a body map says.
enum class EBodyDoubt : uint8_t
{
    NotBelow,      ///< not below the joint that should carry it
    SidesSwapped,  ///< legs: left is not up x forward; arms: not on the same sides as the legs
    ClavicleIsArm, ///< the mapped upper arm is one joint too far out; the clavicle is the real one
    ArmIsClavicle, ///< the mapped upper arm is too short to be one: it is the clavicle
    LegsUp,        ///< the legs point along the trunk in every pose
    OddLength,     ///< a limb's bones are out of proportion, or differ in length from the other side's
};

struct BodyDoubt
{
    EBodyDoubt kind = EBodyDoubt::NotBelow;
    BodyPlace place; ///< the joint concerned; for a whole limb, its upper arm or thigh
};

/// Returns doubts about a body map, from the positions of its joints in the rest pose and some frames; names
/// are ignored. Missing joints raise no doubts. The tree is posed during the call and restored.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body);
/// Same with the skeleton's tree, if it exists already.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body, const CJointTree& tree);

} // namespace gw
