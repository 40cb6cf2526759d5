#pragma once

#include <span>

namespace gw {

/// Smooths a curve of one value a frame without moving it in time: each value becomes a mean of all, the
/// weight of which falls off on both sides within about `frames`. Takes time by the number of values alone.
void SmoothCurve(std::span<float> curve, double frames);

} // namespace gw
