#pragma once

#include <array>
#include <vector>

namespace gw {

class CJointTree;

/// Two chains of joints that mirror each other: bone for bone as long, under one joint.
struct LimbPair
{
    int joint = -1;                         ///< from which both leave
    std::array<std::vector<int>, 2> chains; ///< as far as they mirror each other, as many joints each
    double length = 0.0;                    ///< of one, from the joint on
};

/// The pairs of a tree that may be limbs, the longest first.
std::vector<LimbPair> FindLimbPairs(const CJointTree& tree);

} // namespace gw
