#pragma once

#include "Mat3.h"
#include "Quat.h"

namespace gw {

/// Returns the angle in degrees between two rotations, 0 to 180. A deviation from a rotation beyond rounding
/// also counts as an angle, so a scaled or mirrored matrix never passes.
double DegreesBetween(const Mat3& a, const Mat3& b);
/// Same; a quaternion and its negative are 0 degrees apart.
double DegreesBetween(const Quat& a, const Quat& b);

} // namespace gw
