#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

class CJointTree;

enum class ELimb : uint8_t
{
    Arm,
    Leg,
};

/// The joints of a chain where the upper and lower bone of a limb start and end: upper arm, forearm and hand,
/// or thigh, shin and foot. Indices into the chain.
struct LimbJoints
{
    size_t upper = 0;
    size_t lower = 0;
    size_t end = 0; ///< the chain's size if the lower bone does not end in a joint

    friend bool operator==(const LimbJoints&, const LimbJoints&) = default;
};

/// How well a choice fits a human limb; lower is better, and good ones are below 0.
struct LimbFit
{
    LimbJoints joints;
    double cost = 0.0;
    double length = 0.0; ///< total length of upper and lower bone
    bool found = false;
};

/// Chains of joints, each the child of the previous one, for the same limb on both sides and with the same
/// number of joints; or a single chain.
using LimbChains = std::span<const std::vector<int>>;

/// Returns the best choice.
LimbFit FitLimb(const CJointTree& tree, LimbChains chains, ELimb limb);
/// Returns the cost of a given choice. Not found if a bone has no length.
LimbFit JudgeLimb(const CJointTree& tree, LimbChains chains, ELimb limb, const LimbJoints& joints);

} // namespace gw
