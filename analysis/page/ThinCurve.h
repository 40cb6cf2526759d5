#pragma once

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// A point of a curve: its value in a frame.
struct CurvePoint
{
    int frame;
    float value;
};

/// Reduces a curve to at most about `most` points: the minimum and maximum of each range of frames, in their
/// order, so that no peak is lost. A short curve is kept complete. Numbers that are not finite are skipped.
std::vector<CurvePoint> ThinCurve(std::span<const float> values, size_t most);

} // namespace gw
