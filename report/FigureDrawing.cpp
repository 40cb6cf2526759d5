#include "FigureDrawing.h"

#include "CMarkup.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kDrawingHeight = 200.0;
constexpr double kMargin = 8.0;
constexpr double kMostWidth = 400.0; // a body that lies, arms and legs away

// What the drawings of a pair show, in the figures' unit; the left edge is -halfWidth.
struct Extent
{
    double halfWidth = 0.0;
    double low = 0.0;
    double high = 0.0;

    void Add(const Vec3& point)
    {
        halfWidth =
            std::max(halfWidth, std::hypot(static_cast<double>(point.x), static_cast<double>(point.z)));
        low = std::min(low, static_cast<double>(point.y));
        high = std::max(high, static_cast<double>(point.y));
    }
    void Add(const PosedFigure& figure)
    {
        for (const std::vector<PosedFigure::Line>* lines : {&figure.lines, &figure.badLines})
        {
            for (const PosedFigure::Line& line : *lines)
            {
                Add(line[0]);
                Add(line[1]);
            }
        }
    }
};

// One look at figures: which way is right, and how large.
struct Look
{
    Vec3 right;
    Extent extent;
    double scale;

    double X(const Vec3& point) const { return (Vec3Dot(point, right) + extent.halfWidth) * scale + kMargin; }
    double Y(double height) const { return (extent.high - height) * scale + kMargin; }
    double Width() const { return 2.0 * (extent.halfWidth * scale + kMargin); }
    double Height() const { return (extent.high - extent.low) * scale + 2.0 * kMargin; }
};

void AppendPoint(CMarkup& page, const Look& look, const Vec3& point)
{
    page.Number(look.X(point), 1).Raw(" ").Number(look.Y(static_cast<double>(point.y)), 1);
}

void AppendLines(CMarkup& page, const Look& look, const std::vector<PosedFigure::Line>& lines,
                 std::string_view style)
{
    page.Raw("<path class=\"").Raw(style).Raw("\" d=\"");
    for (const PosedFigure::Line& line : lines)
    {
        page.Raw("M");
        AppendPoint(page, look, line[0]);
        page.Raw("L");
        AppendPoint(page, look, line[1]);
    }
    page.Raw("\"/>");
}

void AppendFigure(CMarkup& page, const Look& look, const PosedFigure& figure, std::string_view side,
                  std::string_view from)
{
    page.Raw("<figure class=\"").Raw(side).Raw("\"><svg viewBox=\"0 0 ").Number(look.Width(), 0).Raw(" ");
    page.Number(look.Height(), 0).Raw("\" role=\"img\" aria-label=\"").Raw(side).Raw(", ").Raw(from);
    page.Raw("\"><path class=\"floor\" d=\"M0 ").Number(look.Y(0.0), 1).Raw("H");
    page.Number(look.Width(), 0).Raw("\"/>");
    AppendLines(page, look, figure.lines, "bones");
    AppendLines(page, look, figure.badLines, "bones bad");
    if (figure.badJoint)
    {
        page.Raw("<circle class=\"bad\" r=\"7\" cx=\"").Number(look.X(*figure.badJoint), 1).Raw("\" cy=\"");
        page.Number(look.Y(static_cast<double>(figure.badJoint->y)), 1).Raw("\"/>");
    }
    page.Raw("</svg><figcaption>").Raw(side).Raw(", ").Raw(from).Raw("</figcaption></figure>\n");
}

} // namespace

void PlaceFigure(PosedFigure& figure, double floor, double scale)
{
    const Vec3 origin{figure.root.x, static_cast<float>(floor), figure.root.z};
    const auto place = [&](Vec3& point) { point = (point - origin) * static_cast<float>(scale); };
    for (std::vector<PosedFigure::Line>* lines : {&figure.lines, &figure.badLines})
    {
        for (PosedFigure::Line& line : *lines)
            std::ranges::for_each(line, place);
    }
    if (figure.badJoint)
        place(*figure.badJoint);
    place(figure.root);
}

void AppendFigures(CMarkup& page, const FigurePair& pair)
{
    Extent extent;
    extent.Add(pair.source);
    extent.Add(pair.result);
    const double scale =
        std::min(kDrawingHeight / std::max(extent.high - extent.low, extent.halfWidth / 10.0),
                 kMostWidth / (2.0 * std::max(extent.halfWidth, 1e-9)));
    if (!std::isfinite(scale) || scale <= 0.0)
        return;
    const Look front{pair.across, extent, scale};
    const Look side{Vec3Cross(pair.across, kVec3UnitY), extent, scale};
    page.Raw("<div class=\"figures\">");
    AppendFigure(page, front, pair.source, "source", "from the front");
    AppendFigure(page, front, pair.result, "result", "from the front");
    AppendFigure(page, side, pair.source, "source", "from its right");
    AppendFigure(page, side, pair.result, "result", "from its right");
    page.Raw("</div>\n");
}

} // namespace gw
