#pragma once

#include "Vec3.h"

#include <span>

namespace gw {

/// Smooths a curve of one value per frame without shifting it in time. Each value becomes a weighted mean of
/// all, with weights that fall off within about `frames` on both sides. Time is linear in the number of
/// values.
void SmoothCurve(std::span<float> curve, double frames);

/// Smooths by how much, and where to, a knee is off the line between hip and ankle: one vector per frame. The
/// direction of a nearly straight leg's knee is then that of the frames around it in which it is bent more.
/// The more a knee is bent, the less its vector is changed, and not at all from the length `far` on. Vectors
/// that are not finite become zero.
void SteadySides(std::span<Vec3> sides, double far, double frames);

} // namespace gw
