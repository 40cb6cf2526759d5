#pragma once

#include "Ref.h"
#include "Vec3.h"

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

namespace gw {

class CTriMesh;

struct LineColor
{
    uint8_t red;
    uint8_t green;
    uint8_t blue;
    uint8_t alpha = 255;

    friend bool operator==(const LineColor&, const LineColor&) = default;
};

/// One end of a line in world space, as a GL vertex.
struct LineEnd
{
    Vec3 point;
    LineColor color;
};

/// Colored lines in drawing order; later ones cover earlier ones. A cleared list keeps its memory.
class CDrawList
{
public:
    void Clear() { m_kEnds.clear(); }
    void AddLine(const Vec3& from, const Vec3& to, LineColor color);
    /// Adds the outline of a triangle: a line from each corner to the next. This draws the same pixels as a
    /// closed loop, and lets loops and single lines share one call.
    void AddLoop(const Vec3& a, const Vec3& b, const Vec3& c, LineColor color);
    /// Returns the ends, two per line.
    std::span<const LineEnd> Ends() const { return m_kEnds; }

private:
    std::vector<LineEnd> m_kEnds;
};

inline constexpr LineColor kAxisColors[] = {
    {255, 0,   0  },
    {0,   255, 0  },
    {0,   0,   255},
};
inline constexpr LineColor kBoneColor{204, 204, 204}; ///< 0.8 of white
inline constexpr LineColor kHighlightColor{255, 255, 0};

/// Appends each mesh: the axes at its origin, a tenth of the radius long if the mesh is not scaled, then the
/// outlines of the first five sixths of its triangles; the last sixth has never been drawn. Meshes under a
/// parent with the highlighted name get the highlight color; an empty name highlights none.
void BuildDrawList(CDrawList& list, std::span<const Ref<CTriMesh>> meshes, float radius,
                   std::string_view highlight);

} // namespace gw
