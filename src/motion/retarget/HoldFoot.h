#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

/// Returns the ankle's path, one position per frame. In the frames of the contacts, x and z change by
/// `steps`, one per frame. Outside of contacts, the ankle returns to its free path. y is always that of the
/// free path.
std::vector<Vec3> HoldFoot(std::span<const Vec3> free, std::span<const Vec3> steps,
                           std::span<const Contact> contacts, double secondsPerFrame);

} // namespace gw
