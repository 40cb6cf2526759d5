#pragma once

#include "BodyJoints.h"

#include <array>

namespace gw {

/// What numbered names say about a body found by shape. Riggers who do not name each joint of a limb name the
/// limb and number its joints: "arm_L_1", "arm_L_2". Such a name says less than "forearm", but it can
/// agree with what the shape says.
struct NumberedChains
{
    /// joints in a chain that is called what the body takes it for, in the order of BodyPlaces()
    std::array<bool, kBodyPlaceCount> agrees{};
    /// 1 if both joints of every limb are called by its side, -1 if all are called by the other; otherwise 0
    int sides = 0;
};

/// Compares the names of a skeleton with a body found in it. The order of numbers does not matter, and the
/// first joint may have none.
NumberedChains FindNumberedChains(CNode& root, const CBodyMap& body);

} // namespace gw
