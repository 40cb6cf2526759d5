#pragma once

#include "Mat3.h"

namespace gw {

/// A direction in a space of these axes, as the world has it: the row times the matrix.
Vec3 ToWorld(const Vec3& direction, const Mat3& axes);
/// A world direction, as a space of these axes has it.
Vec3 ToLocal(const Vec3& direction, const Mat3& axes);

/// The least rotation that takes one unit direction to another; half a turn about some axis across where they
/// are opposite.
Mat3 SwingBetween(const Vec3& from, const Vec3& to);

} // namespace gw
