#include "FigureDrawing.h"

#include "CMarkup.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// All drawings of a page have the same size; figures are scaled to fit.
constexpr double kWidth = 260.0;
constexpr double kHeight = 200.0;
constexpr double kMargin = 8.0;

struct Range
{
    double least = 0.0;
    double largest = 0.0;

    void Add(double value)
    {
        least = std::min(least, value);
        largest = std::max(largest, value);
    }
    double Extent() const { return largest - least; }
};

template <class Visit>
void EachPoint(const FigurePair& pair, const Visit& visit)
{
    for (const PosedFigure* figure : {&pair.source, &pair.result})
    {
        for (const std::vector<PosedFigure::Line>* lines : {&figure->lines, &figure->badLines})
        {
            for (const PosedFigure::Line& line : *lines)
                std::ranges::for_each(line.ends, visit);
        }
    }
}

// A view of the figures. The origin, on the floor below their roots, is always visible.
struct Look
{
    Vec3 right; ///< horizontal unit vector
    Range across;
    Range height;
    double scale = 1.0; ///< drawing units per figure unit

    Look(const FigurePair& pair, const Vec3& direction) : right(direction)
    {
        EachPoint(pair, [this](const Vec3& point) {
            across.Add(Vec3Dot(point, right));
            height.Add(static_cast<double>(point.y));
        });
    }
    double LargestScale() const { return std::min(kWidth / across.Extent(), kHeight / height.Extent()); }
    double X(const Vec3& point) const
    {
        const double middle = 0.5 * (across.least + across.largest);
        return (Vec3Dot(point, right) - middle) * scale + 0.5 * kWidth + kMargin;
    }
    double Y(double y) const { return (height.least - y) * scale + kHeight + kMargin; }
};

void AppendPoint(CMarkup& page, const Look& look, const Vec3& point)
{
    page.Number(look.X(point), 1).Raw(" ").Number(look.Y(static_cast<double>(point.y)), 1);
}

void AppendLines(CMarkup& page, const Look& look, const std::vector<PosedFigure::Line>& lines,
                 std::string_view style)
{
    for (const EFigureSide side : {EFigureSide::Right, EFigureSide::Middle, EFigureSide::Left})
    {
        page.Raw("<path class=\"").Raw(style).Raw(" ").Raw(FigureSideName(side)).Raw("\" d=\"");
        for (const PosedFigure::Line& line : lines)
        {
            if (line.side != side)
                continue;
            page.Raw("M");
            AppendPoint(page, look, line.ends[0]);
            page.Raw("L");
            AppendPoint(page, look, line.ends[1]);
        }
        page.Raw("\"/>");
    }
}

void AppendFigure(CMarkup& page, const Look& look, const PosedFigure& figure, std::string_view side,
                  std::string_view from)
{
    page.Raw("<figure class=\"").Raw(side).Raw("\"><svg viewBox=\"0 0 276 216\" role=\"img\" aria-label=\"");
    page.Raw(side).Raw(", ").Raw(from).Raw("\"><path class=\"floor\" d=\"M0 ");
    page.Number(look.Y(0.0), 1).Raw("H276\"/>");
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
            std::ranges::for_each(line.ends, place);
    }
    if (figure.badJoint)
        place(*figure.badJoint);
    place(figure.root);
}

void AppendFigures(CMarkup& page, const FigurePair& pair)
{
    Look front(pair, pair.across);
    Look side(pair, Vec3Cross(pair.across, kVec3UnitY));
    const double scale = std::min(front.LargestScale(), side.LargestScale());
    if (!std::isfinite(scale) || scale <= 0.0)
        return;
    front.scale = side.scale = scale;
    page.Raw("<div class=\"figures\">");
    AppendFigure(page, front, pair.source, "source", "from the front");
    AppendFigure(page, front, pair.result, "result", "from the front");
    AppendFigure(page, side, pair.source, "source", "from its right");
    AppendFigure(page, side, pair.result, "result", "from its right");
    page.Raw("</div>\n");
}

} // namespace gw
