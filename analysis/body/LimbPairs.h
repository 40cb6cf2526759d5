#pragma once

#include <array>
#include <vector>

namespace gw {

class CJointTree;

/// Two chains of joints that mirror each other: equal bone lengths, starting at one joint.
struct LimbPair
{
    int joint = -1;                         ///< where both branch off
    std::array<std::vector<int>, 2> chains; ///< as far as they mirror each other; equal numbers of joints
    double length = 0.0;                    ///< of one chain, starting at the joint
};

/// Returns the pairs of a tree that can be limbs, longest first.
std::vector<LimbPair> FindLimbPairs(const CJointTree& tree);

} // namespace gw
