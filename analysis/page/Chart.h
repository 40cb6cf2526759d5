#pragma once

#include "FindContacts.h"

#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CMarkup;

/// A curve over the frames of a motion. `style` is a CSS class of the page: "source", "result" or another.
struct ChartCurve
{
    std::string_view name;
    std::string_view style;
    std::span<const float> values;
};

/// Ranges of frames with a property, drawn as a strip below the curves.
struct ChartStrip
{
    std::string_view name;
    std::string_view style;
    std::span<const Contact> stretches;
};

/// A frame that is one of the page's worst frames, with its number in that list.
struct ChartMark
{
    int frame;
    size_t number;
};

/// Curves over time with common axes.
struct Chart
{
    std::string title; ///< escaped when the chart is drawn
    std::string_view unit;
    std::vector<ChartCurve> curves;
    std::vector<ChartStrip> strips;
    std::span<const ChartMark> marks;
    double leastRange = 1.0; ///< of the axis, so that rounding errors do not look like a result
    bool fromZero = false;   ///< include 0 on the axis, whatever the curves' range is
};

/// Appends a chart; nothing if no curve has any frames. Curves are drawn with at most about `mostPoints`
/// points.
void AppendChart(CMarkup& page, const Chart& chart, size_t mostPoints);

} // namespace gw
