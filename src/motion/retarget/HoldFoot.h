#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// The paths of a foot: one position per frame, all in the target's scale.
struct FootPaths
{
    std::span<const Vec3> free;        ///< the target's ankle if nothing holds it
    std::span<const Vec3> toe;         ///< vector from the target's ankle to its toe
    std::span<const Vec3> sourceAnkle; ///< the source's ankle
    std::span<const Vec3> sourceToe;   ///< the source's toe
    double leg;                        ///< length of the target's leg
};

/// Returns the ankle's path, one position per frame. In the frames of the contacts, x and z are such that the
/// foot stands still, and rolls over its toe when the source's foot does. Outside of contacts, the ankle
/// returns to its free path. y is always that of the free path. The source may jump after the frames `jumps`,
/// which are in order.
std::vector<Vec3> HoldFoot(const FootPaths& foot, std::span<const Contact> contacts, double secondsPerFrame,
                           std::span<const size_t> jumps = {});

} // namespace gw
