#pragma once

#include "Mat4.h"
#include "Quat.h"

namespace gw {

/// Returns the angle in degrees between two rotations, 0 to 180. A deviation from a rotation beyond rounding
/// also counts as an angle, so a scaled or mirrored matrix never passes.
double DegreesBetween(const Mat3& a, const Mat3& b);
/// Same; a quaternion and its negative are 0 degrees apart.
double DegreesBetween(const Quat& a, const Quat& b);

/// Expects each number of two vectors or matrices to be that near.
void ExpectNear(const Vec3& found, const Vec3& expected, double tolerance);
void ExpectNear(const Mat4& found, const Mat4& expected, double tolerance);

} // namespace gw
