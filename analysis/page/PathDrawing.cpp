#include "PathDrawing.h"

#include "CAxis.h"
#include "CMarkup.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <limits>
#include <string_view>

namespace gw {

namespace {

constexpr double kPathWidth = 300.0;
constexpr double kPathHeight = 130.0;
constexpr double kLeastExtent = 100.0; // mm; someone who stands only sways, which should not look like a walk

struct PathRange
{
    double least = std::numeric_limits<double>::infinity();
    double largest = -std::numeric_limits<double>::infinity();

    void Add(float value)
    {
        if (!std::isfinite(value))
            return;
        least = std::min(least, static_cast<double>(value));
        largest = std::max(largest, static_cast<double>(value));
    }
    double Middle() const { return 0.5 * (least + largest); }
    double Extent() const { return largest - least; }
};

// Maps the ground to the drawing.
struct Ground
{
    PathRange x;
    PathRange z;
    double scale = 0.0; // drawing units per mm

    explicit Ground(std::initializer_list<const std::vector<Vec3>*> ways)
    {
        for (const std::vector<Vec3>* way : ways)
        {
            for (const Vec3& place : *way)
            {
                x.Add(place.x);
                z.Add(place.z);
            }
        }
        scale = std::min(kPathWidth / std::max(x.Extent(), kLeastExtent),
                         kPathHeight / std::max(z.Extent(), kLeastExtent));
    }
    double X(const Vec3& place) const
    {
        return (static_cast<double>(place.x) - x.Middle()) * scale + 0.5 * kPathWidth;
    }
    double Y(const Vec3& place) const
    {
        return (static_cast<double>(place.z) - z.Middle()) * scale + 0.5 * kPathHeight;
    }
};

void AppendWay(CMarkup& page, const Ground& ground, const std::vector<Vec3>& way, std::string_view style,
               size_t mostPoints)
{
    const size_t step = (way.size() + mostPoints - 1) / std::max<size_t>(mostPoints, 1);
    page.Raw("<path class=\"curve ").Raw(style).Raw("\" d=\"");
    const char* command = "M";
    for (size_t f = 0; f < way.size(); f += std::max<size_t>(step, 1))
    {
        if (!std::isfinite(way[f].x) || !std::isfinite(way[f].z))
            continue;
        page.Raw(command).Number(ground.X(way[f]), 1).Raw(" ").Number(ground.Y(way[f]), 1);
        command = "L";
    }
    page.Raw("\"/><circle class=\"").Raw(style).Raw("\" r=\"3\" cx=\"").Number(ground.X(way.front()), 1);
    page.Raw("\" cy=\"").Number(ground.Y(way.front()), 1).Raw("\"/>");
}

// Appends a scale bar with a round length at the bottom, and its length.
void AppendScale(CMarkup& page, const Ground& ground)
{
    const std::vector<double> ticks = CAxis(0.0, kPathWidth / ground.scale, 5).Ticks();
    page.Raw("<path class=\"scale\" d=\"M4 ").Number(kPathHeight + 8.0, 0).Raw("h");
    page.Number(ticks[1] * ground.scale, 1).Raw("\"/><text x=\"").Number(ticks[1] * ground.scale + 9.0, 1);
    page.Raw("\" y=\"").Number(kPathHeight + 11.0, 0).Raw("\">").Number(ticks[1], 0).Raw(" mm</text>");
}

} // namespace

void AppendPaths(CMarkup& page, const std::vector<Vec3>& source, const std::vector<Vec3>& result,
                 size_t mostPoints)
{
    if (source.empty() || result.empty())
        return;
    const Ground ground{&source, &result};
    if (!std::isfinite(ground.scale) || !(ground.scale > 0.0))
        return;
    page.Raw(
        "<figure class=\"chart path\"><figcaption><b>Path of the hips</b> from above, starting at the dot"
        "<span class=\"legend\"> <i class=\"key source\"></i>source <i class=\"key result\"></i>result"
        "</span></figcaption>\n<svg viewBox=\"-6 -6 312 152\" role=\"img\" aria-label=\"Path of the hips "
        "from above\">");
    AppendWay(page, ground, source, "source", mostPoints);
    AppendWay(page, ground, result, "result", mostPoints);
    AppendScale(page, ground);
    page.Raw("</svg></figure>\n");
}

} // namespace gw
