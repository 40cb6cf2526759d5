#pragma once

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// A point of a curve: what it is in a frame.
struct CurvePoint
{
    int frame;
    float value;
};

/// A curve in at most about `most` points: the least and the largest value of each stretch of frames, in
/// their order, so that no peak is lost. A short curve is taken whole. Numbers that are not finite are left
/// out.
std::vector<CurvePoint> ThinCurve(std::span<const float> values, size_t most);

} // namespace gw
