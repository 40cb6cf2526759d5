#pragma once

#include "Mat3.h"

#include <string_view>

namespace gw {

// Directions, angles and rotations between them. Rotations are row matrices: a direction d becomes d · M.

/// Returns a rotated direction; equivalently, converts a local direction to world space.
Vec3 Turned(const Vec3& direction, const Mat3& turn);
/// Converts a world direction to the space of these axes.
Vec3 ToLocal(const Vec3& direction, const Mat3& axes);
/// Returns a direction without its component along a unit vector.
Vec3 Across(const Vec3& direction, const Vec3& axis);
/// Returns the world axis, positive or negative, closest to a direction.
Vec3 NearestAxis(const Vec3& direction);
/// Returns "Y" or "-Z".
std::string_view AxisName(const Vec3& axis);

/// Returns the angle between two directions in degrees, accurate for small angles too. Both must have a
/// length.
double AngleBetween(const Vec3& a, const Vec3& b);
/// Returns the signed angle in degrees, -180 to 180, of the rotation about the unit vector `axis` from one
/// direction to another, seen along the axis; 0 if one of them lies along it.
double TwistBetween(const Vec3& from, const Vec3& to, const Vec3& axis);
/// Returns the angle of a rotation in degrees, 0 to 180.
double AngleOf(const Mat3& turn);

/// Returns the rotation about a unit vector by an angle in degrees.
Mat3 TurnAbout(const Vec3& axis, double degrees);
/// Returns the smallest rotation from one direction to another; half a turn about any perpendicular axis if
/// they are opposite. The identity if one has no length.
Mat3 LeastSwing(const Vec3& from, const Vec3& to);
/// Returns the rotation that takes `up` to +Y and `left` as close to +X as possible. If `left` is parallel to
/// `up`, the rotation about +Y is arbitrary.
Mat3 TurnUpright(const Vec3& up, const Vec3& left);

} // namespace gw
