// Charts scale with the page. Lines keep their width, and the numbers on the axes are page text, so they have
// the same size on phones and wide screens.

#include "Chart.h"

#include "CAxis.h"
#include "CMarkup.h"
#include "ThinCurve.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace gw {

namespace {

constexpr double kWidth = 1000.0;
constexpr double kHeight = 100.0;
constexpr double kStripHeight = 5.0;
constexpr int kHeightSteps = 3;
constexpr int kFrameSteps = 6;

struct ThinnedCurve
{
    const ChartCurve& curve;
    std::vector<CurvePoint> points;
};

size_t FrameCount(const Chart& chart)
{
    size_t count = 0;
    for (const ChartCurve& curve : chart.curves)
        count = std::max(count, curve.values.size());
    return count;
}

CAxis HeightAxis(const Chart& chart, const std::vector<ThinnedCurve>& curves)
{
    double least = chart.fromZero ? 0.0 : std::numeric_limits<double>::infinity();
    double largest = chart.fromZero ? 0.0 : -std::numeric_limits<double>::infinity();
    for (const ThinnedCurve& curve : curves)
    {
        for (const CurvePoint& point : curve.points)
        {
            least = std::min(least, static_cast<double>(point.value));
            largest = std::max(largest, static_cast<double>(point.value));
        }
    }
    if (!(least <= largest))
        return {0.0, 1.0, kHeightSteps};
    if (chart.fromZero && least > -0.01 * chart.leastRange)
        least = 0.0;
    return {least, std::max(largest, least + chart.leastRange), kHeightSteps};
}

// Draws one chart.
class CChartDrawing
{
public:
    CChartDrawing(CMarkup& page, const Chart& chart, std::vector<ThinnedCurve> curves, size_t frameCount)
        : page_(page), chart_(chart), m_kCurves(std::move(curves)), m_kHeight(HeightAxis(chart, m_kCurves)),
          m_fLastFrame(std::max(1.0, static_cast<double>(frameCount) - 1.0))
    {
    }

    void Draw()
    {
        page_.Raw("<figure class=\"chart\"><figcaption><b>").Name(chart_.title).Raw("</b> ");
        page_.Raw(chart_.unit);
        DrawLegend();
        page_.Raw("</figcaption>\n<div class=\"plot\">");
        page_.Raw("<svg viewBox=\"0 0 1000 100\" preserveAspectRatio=\"none\" role=\"img\" aria-label=\"");
        page_.Name(chart_.title).Raw(" over the frames\">");
        DrawGrid();
        DrawStrips();
        DrawMarks();
        for (const ThinnedCurve& curve : m_kCurves)
            DrawCurve(curve);
        page_.Raw("</svg>");
        LabelHeights();
        LabelFrames();
        LabelMarks();
        page_.Raw("</div></figure>\n");
    }

private:
    double X(double frame) const { return frame / m_fLastFrame * kWidth; }
    double Y(double value) const { return (1.0 - m_kHeight.Share(value)) * kHeight; }

    void DrawLegend()
    {
        page_.Raw("<span class=\"legend\">");
        for (const ChartCurve& curve : chart_.curves)
            page_.Raw(" <i class=\"key ").Raw(curve.style).Raw("\"></i>").Raw(curve.name);
        for (const ChartStrip& strip : chart_.strips)
            page_.Raw(" <i class=\"key strip ").Raw(strip.style).Raw("\"></i>").Raw(strip.name);
        page_.Raw("</span>");
    }
    void DrawGrid()
    {
        page_.Raw("<path class=\"grid\" d=\"");
        for (const double tick : m_kHeight.Ticks())
            page_.Raw("M0 ").Number(Y(tick), 2).Raw("H1000");
        page_.Raw("\"/>");
    }
    // Strips are stacked at the bottom, the first one on top.
    void DrawStrips()
    {
        double top = kHeight - kStripHeight * static_cast<double>(chart_.strips.size());
        for (const ChartStrip& strip : chart_.strips)
        {
            page_.Raw("<path class=\"strip ").Raw(strip.style).Raw("\" d=\"");
            for (const Contact& stretch : strip.stretches)
            {
                page_.Raw("M").Number(X(stretch.first), 1).Raw(" ").Number(top, 1);
                page_.Raw("H").Number(X(stretch.end - 1), 1).Raw("v").Number(kStripHeight - 1.0, 1);
                page_.Raw("H").Number(X(stretch.first), 1).Raw("z");
            }
            page_.Raw("\"/>");
            top += kStripHeight;
        }
    }
    void DrawMarks()
    {
        for (const ChartMark& mark : chart_.marks)
            page_.Raw("<path class=\"mark\" d=\"M").Number(X(mark.frame), 1).Raw(" 0V100\"/>");
    }
    void DrawCurve(const ThinnedCurve& curve)
    {
        page_.Raw("<path class=\"curve ").Raw(curve.curve.style).Raw("\" d=\"");
        const char* command = "M";
        for (const CurvePoint& point : curve.points)
        {
            page_.Raw(command).Number(X(point.frame), 1).Raw(" ");
            page_.Number(Y(static_cast<double>(point.value)), 1);
            command = "L";
        }
        if (curve.points.size() == 1)
            page_.Raw("h1000"); // a single frame
        page_.Raw("\"/>");
    }
    void LabelHeights()
    {
        for (const double tick : m_kHeight.Ticks())
        {
            page_.Raw("<span class=\"y\" style=\"top:").Number(Y(tick), 1).Raw("%\">");
            page_.Number(tick, m_kHeight.Decimals()).Raw("</span>");
        }
    }
    // The axis ends at a round number, which may be after the end of the motion.
    void LabelFrames()
    {
        for (const double tick : CAxis(0.0, m_fLastFrame, kFrameSteps).Ticks())
        {
            if (tick > m_fLastFrame || tick != std::floor(tick))
                continue;
            page_.Raw("<span class=\"x\" style=\"left:").Number(X(tick) / kWidth * 100.0, 1).Raw("%\">");
            page_.Number(tick, 0).Raw("</span>");
        }
    }
    void LabelMarks()
    {
        for (const ChartMark& mark : chart_.marks)
        {
            page_.Raw("<span class=\"number\" style=\"left:").Number(X(mark.frame) / kWidth * 100.0, 1);
            page_.Raw("%\">").Integer(static_cast<long long>(mark.number)).Raw("</span>");
        }
    }

    CMarkup& page_;
    const Chart& chart_;
    std::vector<ThinnedCurve> m_kCurves;
    CAxis m_kHeight;
    double m_fLastFrame;
};

} // namespace

void AppendChart(CMarkup& page, const Chart& chart, size_t mostPoints)
{
    const size_t frameCount = FrameCount(chart);
    if (frameCount == 0)
        return;
    std::vector<ThinnedCurve> curves;
    for (const ChartCurve& curve : chart.curves)
        curves.push_back({curve, ThinCurve(curve.values, mostPoints)});
    CChartDrawing(page, chart, std::move(curves), frameCount).Draw();
}

} // namespace gw
