#pragma once

#include "FindContacts.h"

#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CMarkup;

/// A curve over the frames of a motion. Style is a class of the page: "source", "result", or another.
struct ChartCurve
{
    std::string_view name;
    std::string_view style;
    std::span<const float> values;
};

/// Stretches of frames in which something holds, as a strip under the curves.
struct ChartStrip
{
    std::string_view name;
    std::string_view style;
    std::span<const Contact> stretches;
};

/// A frame that the worst frames of the page show, under its number there.
struct ChartMark
{
    int frame;
    size_t number;
};

/// Curves over time on common axes.
struct Chart
{
    std::string title; ///< escaped by the chart
    std::string_view unit;
    std::vector<ChartCurve> curves;
    std::vector<ChartStrip> strips;
    std::span<const ChartMark> marks;
    bool fromZero = false; ///< 0 stands on the axis, whatever the curves do
};

/// Appends a chart; nothing where no curve has a frame. Curves are drawn in at most about `mostPoints`
/// points.
void AppendChart(CMarkup& page, const Chart& chart, size_t mostPoints);

} // namespace gw
