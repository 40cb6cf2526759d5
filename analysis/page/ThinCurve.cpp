#include "ThinCurve.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

void AddStretch(std::span<const float> values, size_t begin, size_t end, std::vector<CurvePoint>& points)
{
    size_t least = end;
    size_t largest = end;
    for (size_t f = begin; f < end; ++f)
    {
        if (!std::isfinite(values[f]))
            continue;
        least = least == end || values[f] < values[least] ? f : least;
        largest = largest == end || values[f] > values[largest] ? f : largest;
    }
    if (least == end)
        return;
    for (const size_t f : {std::min(least, largest), std::max(least, largest)})
    {
        if (points.empty() || points.back().frame != static_cast<int>(f))
            points.push_back({static_cast<int>(f), values[f]});
    }
}

} // namespace

std::vector<CurvePoint> ThinCurve(std::span<const float> values, size_t most)
{
    // Two points per range; if the curve fits, each range is one frame.
    const size_t stretches = values.size() <= most ? values.size() : std::max<size_t>(most / 2, 1);
    std::vector<CurvePoint> points;
    for (size_t i = 0; i < stretches; ++i)
        AddStretch(values, i * values.size() / stretches, (i + 1) * values.size() / stretches, points);
    return points;
}

} // namespace gw
