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

/// Which joints of a chain begin the upper and the lower bone of a limb and what is at its end: upper arm,
/// forearm and hand, or thigh, shin and foot. Indices into the chain.
struct LimbJoints
{
    size_t upper = 0;
    size_t lower = 0;
    size_t end = 0; ///< the number of joints where the lower bone ends in no joint

    friend bool operator==(const LimbJoints&, const LimbJoints&) = default;
};

/// How well such a choice suits a human limb; the lower the better, below 0 for a good one.
struct LimbFit
{
    LimbJoints joints;
    double cost = 0.0;
    double length = 0.0; ///< upper and lower bone together
    bool found = false;
};

/// Chains of joints, each the child of the one before, that stand for the same limb on both sides and have as
/// many joints; or one chain alone.
using LimbChains = std::span<const std::vector<int>>;

/// The best choice there is.
LimbFit FitLimb(const CJointTree& tree, LimbChains chains, ELimb limb);
/// What a given choice costs. Not found where a bone has no length.
LimbFit JudgeLimb(const CJointTree& tree, LimbChains chains, ELimb limb, const LimbJoints& joints);

} // namespace gw
