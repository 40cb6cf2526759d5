#pragma once

#include "Mat3.h"
#include "Quat.h"

namespace gw {

/// The angle in degrees of the turn from one rotation to another, 0 to 180. More than rounding away from a
/// rotation counts as an angle as well, so that a matrix with a wrong scale or a mirrored one never passes.
double DegreesBetween(const Mat3& a, const Mat3& b);
/// The same; a quaternion and its negative are 0 degrees apart.
double DegreesBetween(const Quat& a, const Quat& b);

} // namespace gw
