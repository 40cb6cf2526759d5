#pragma once

#include <span>

namespace gw {

/// Smooths a curve of one value per frame without shifting it in time. Each value becomes a weighted mean of
/// all, with weights that fall off within about `frames` on both sides. Time is linear in the number of
/// values.
void SmoothCurve(std::span<float> curve, double frames);

} // namespace gw
