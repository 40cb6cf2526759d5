#pragma once

#include "BodyJoints.h"

#include <cstdint>
#include <vector>

namespace gw {

class CJointTree;

/// What speaks against a bone map. The first six are about where the joints of a body lie.
enum class EDoubt : uint8_t
{
    NotBelow,      ///< not below the joint that should carry it
    SidesSwapped,  ///< legs: left is not up x forward; arms: not on the same sides as the legs
    ClavicleIsArm, ///< the mapped upper arm is one joint too far out; the clavicle is the real one
    ArmIsClavicle, ///< the mapped upper arm is too short to be one: it is the clavicle
    LegsUp,        ///< the legs point along the trunk in every pose
    OddLength,     ///< a limb's bones are out of proportion, or differ in length from the other side's
    OtherName,     ///< by its name, the joint is another part of the body
    SpineCut,      ///< spine joints above the one that drives the upper torso are left out
    Turned,        ///< the bone ends up turned sideways, by about a quarter turn or more
};

/// Whether a doubt is about which joint is which, rather than about how well the bones come out.
constexpr bool IsOfRoles(EDoubt doubt)
{
    return doubt <= EDoubt::OtherName;
}

struct BodyDoubt
{
    EDoubt kind = EDoubt::NotBelow;
    BodyPlace place; ///< the joint concerned; for a whole limb, its upper arm or thigh
};

/// Returns doubts about a body map, from the positions of its joints in the rest pose and some frames; names
/// are ignored. Missing joints raise no doubts. The tree is posed during the call and restored.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body);
/// Same with the skeleton's tree, if it exists already.
std::vector<BodyDoubt> CheckBody(const CBodyMap& body, const CJointTree& tree);

} // namespace gw
