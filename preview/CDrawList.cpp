#include "CDrawList.h"

#include "CTriMesh.h"

#include <algorithm>

namespace gw {

namespace {

constexpr float kAxisLength = 0.1f; // in radii

void AddAxes(CDrawList& list, const Mat4& world, float radius)
{
    const Vec3 origin = world.Translation();
    for (int axis = 0; axis < 3; ++axis)
    {
        const Vec3 unit = world.Row(axis) + origin;
        list.AddLine(origin, origin + (unit - origin) * radius * kAxisLength, kAxisColors[axis]);
    }
}

LineColor ColorOf(const CTriMesh& mesh, std::string_view highlight)
{
    const CSpatial* const parent = mesh.GetParent();
    const bool highlighted = !highlight.empty() && parent && parent->NameView() == highlight;
    return highlighted ? kHighlightColor : kBoneColor;
}

// The stored count can be larger than the number of triangles.
size_t DrawnTriangles(CTriMesh& mesh)
{
    const auto lines = static_cast<int64_t>(2.5 * mesh.GetTriangleQuantity());
    const size_t drawn = lines > 0 ? static_cast<size_t>(lines + 2) / 3 : 0;
    return std::min(drawn, mesh.XYZTriIndexBuffer().size() / 3);
}

void AddFaces(CDrawList& list, CTriMesh& mesh, LineColor color)
{
    const std::span<const Vec3> points = mesh.WorldXYZBuffer();
    const size_t corners = 3 * DrawnTriangles(mesh);
    for (size_t corner = 0; corner < corners; corner += 3)
    {
        const uint32_t* const p = &mesh.XYZTriIndexBuffer()[corner];
        if (std::max({p[0], p[1], p[2]}) < points.size()) // a file can refer to points that do not exist
            list.AddLoop(points[p[0]], points[p[1]], points[p[2]], color);
    }
}

} // namespace

void CDrawList::AddLine(const Vec3& from, const Vec3& to, LineColor color)
{
    m_kEnds.insert(m_kEnds.end(), {
                                      {from, color},
                                      {to,   color}
    });
}

void CDrawList::AddLoop(const Vec3& a, const Vec3& b, const Vec3& c, LineColor color)
{
    AddLine(a, b, color);
    AddLine(b, c, color);
    AddLine(c, a, color);
}

void BuildDrawList(CDrawList& list, std::span<const Ref<CTriMesh>> meshes, float radius,
                   std::string_view highlight)
{
    for (const Ref<CTriMesh>& mesh : meshes)
    {
        AddAxes(list, mesh->m_kWorldMatrix, radius);
        AddFaces(list, *mesh, ColorOf(*mesh, highlight));
    }
}

} // namespace gw
