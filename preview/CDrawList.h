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

/// One end of a line, in world space: a vertex as GL takes it.
struct LineEnd
{
    Vec3 point;
    LineColor color;
};

/// Coloured lines in the order of drawing, where later ones cover earlier ones. Cleared lists keep their
/// memory.
class CDrawList
{
public:
    void Clear() { m_kEnds.clear(); }
    void AddLine(const Vec3& from, const Vec3& to, LineColor color);
    /// The outline of a triangle: a line from each corner to the next. This gives the pixels of a closed
    /// loop, and loops and single lines can be drawn by one call.
    void AddLoop(const Vec3& a, const Vec3& b, const Vec3& c, LineColor color);
    /// Two ends for each line.
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

/// Appends each mesh: the axes at its origin, a tenth of the radius long where the mesh is not scaled, then
/// the outlines of its first five sixths of triangles; the last sixth has never been drawn. Meshes under a
/// parent of the highlighted name take the highlight's colour; an empty name highlights none.
void BuildDrawList(CDrawList& list, std::span<const Ref<CTriMesh>> meshes, float radius,
                   std::string_view highlight);

} // namespace gw
