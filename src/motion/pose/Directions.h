#pragma once

#include "Mat3.h"

#include <string_view>

namespace gw {

// Directions, angles and the rotations between them. Rotations are row matrices: a direction d becomes d · M.

/// A direction turned by a rotation; one in a space of these axes, as the world has it.
Vec3 Turned(const Vec3& direction, const Mat3& turn);
/// A world direction in a space of these axes.
Vec3 ToLocal(const Vec3& direction, const Mat3& axes);
/// A direction without its part along a unit vector.
Vec3 Across(const Vec3& direction, const Vec3& axis);
/// The world axis, plus or minus, that is nearest to a direction.
Vec3 NearestAxis(const Vec3& direction);
/// "Y" or "-Z".
std::string_view AxisName(const Vec3& axis);

/// The angle between two directions in degrees, exact for small angles too. Not to be asked of one without
/// a length.
double AngleBetween(const Vec3& a, const Vec3& b);
/// The angle in degrees, -180 to 180, by which a rotation about `axis`, a unit vector, takes one direction to
/// another as seen along it; 0 if one of them lies along the axis.
double TwistBetween(const Vec3& from, const Vec3& to, const Vec3& axis);
/// The angle of a rotation in degrees, 0 to 180.
double AngleOf(const Mat3& turn);

/// The rotation about a unit vector by an angle in degrees.
Mat3 TurnAbout(const Vec3& axis, double degrees);
/// The rotation by the least angle that takes one direction to another; half a turn about some axis across if
/// they are opposite. The identity if one has no length.
Mat3 LeastSwing(const Vec3& from, const Vec3& to);
/// The rotation that takes `up` to +Y and `left` as near to +X as it can. A `left` along `up` leaves the
/// turn about it open.
Mat3 TurnUpright(const Vec3& up, const Vec3& left);

} // namespace gw
