// Triangle meshes have separate indices per corner for points, normals, colors and texture coordinates, but a
// graphics card needs a single one. BuildVertexTable numbers each distinct combination of indices as one
// render vertex. It sorts the corners by their combinations, so the numbering depends only on the index
// lists.

#include "CTriMesh.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "CTriMeshUVWMap.h"
#include "MakeBlock.h"

#include <algorithm>
#include <limits>
#include <numeric>
#include <utility>

namespace gw {

const CRTTI CTriMesh::ms_kRTTI{"CTriMesh", &CGeometry::ms_kRTTI};

namespace {

// The index lists that distinguish render vertices, with one entry per corner.
using IndexLists = std::vector<std::span<const uint32_t>>;

// Compares the indices of corners a and b, list by list, as signed numbers.
bool ComesBefore(const IndexLists& lists, uint32_t a, uint32_t b)
{
    for (const auto& list : lists)
    {
        if (list[a] != list[b])
            return static_cast<int32_t>(list[a]) < static_cast<int32_t>(list[b]);
    }
    return false;
}

// Same for a single list of values below the number of corners, which is the case for every bone.
std::vector<uint32_t> NumberValues(std::span<const uint32_t> list, std::span<uint32_t> vertices)
{
    constexpr uint32_t kUnused = std::numeric_limits<uint32_t>::max();
    std::vector<uint32_t> cornerOf;
    cornerOf.reserve(vertices.size());
    std::vector<uint32_t> numberOf(vertices.size(), kUnused);
    for (size_t corner = 0; corner < vertices.size(); ++corner)
        numberOf[list[corner]] = static_cast<uint32_t>(corner);
    for (uint32_t& number : numberOf)
    {
        if (number != kUnused)
            cornerOf.push_back(std::exchange(number, static_cast<uint32_t>(cornerOf.size())));
    }
    std::ranges::transform(list.first(vertices.size()), vertices.begin(),
                           [&](uint32_t value) { return numberOf[value]; });
    return cornerOf;
}

// Numbers the distinct corners in sorted order and stores each corner's number in `vertices`. Returns one
// corner for each number.
std::vector<uint32_t> NumberCorners(const IndexLists& lists, std::span<uint32_t> vertices)
{
    const auto isBelow = [&](uint32_t value) { return value < vertices.size(); };
    if (lists.size() == 1 && std::ranges::all_of(lists.front().first(vertices.size()), isBelow))
        return NumberValues(lists.front(), vertices);
    std::vector<uint32_t> order(vertices.size());
    std::iota(order.begin(), order.end(), 0);
    std::ranges::sort(order, [&](uint32_t a, uint32_t b) { return ComesBefore(lists, a, b); });
    std::vector<uint32_t> cornerOf;
    for (const uint32_t corner : order)
    {
        if (cornerOf.empty() || ComesBefore(lists, cornerOf.back(), corner))
            cornerOf.push_back(corner);
        vertices[corner] = static_cast<uint32_t>(cornerOf.size() - 1);
    }
    return cornerOf;
}

// Sets each render vertex to the index of its corner; a list that does not take part has no vertices.
void TakeIndices(std::span<const uint32_t> list, std::span<const uint32_t> cornerOf,
                 std::span<uint32_t> vertices)
{
    for (size_t vertex = 0; vertex < vertices.size(); ++vertex)
        vertices[vertex] = list[cornerOf[vertex]];
}

} // namespace

CTriMesh::CTriMesh() = default;
CTriMesh::CTriMesh(const CTriMesh& source) = default;
CTriMesh::~CTriMesh() = default;

CObject* CTriMesh::CreateClone() const
{
    return new CTriMesh(*this);
}

void CTriMesh::Fields(CFieldArchive& archive)
{
    CGeometry::Fields(archive);
    archive.Signed("triangle quantity", m_iTriangleCount);
    const int64_t corners = int64_t{3} * m_iTriangleCount;
    archive.OptionalBlock("XYZTriIndexBuffer", m_kXYZTriIndex, corners);
    archive.OptionalBlock("NormalTriIndexBuffer", m_kNormalTriIndex, corners);
    archive.OptionalBlock("ColorTriIndexBuffer", m_kColorTriIndex, corners);
    archive.OptionalBlock("VertexTriIndexBuffer", m_kVertexTriIndex, corners);
    archive.OptionalBlock("TriangleMtlID", m_kTriangleMtlID, m_iTriangleCount);
    archive.OptionalBlock("SmoothFlag", m_kSmoothFlag, m_iTriangleCount);
    archive.Links("m_apkUVWMap", m_apkUVWMap);
    archive.Array("m_kAttributeRanges", m_kAttributeRanges, [](CFieldArchive& fields, AttributeRange& range) {
        fields.Signed("m_iID", range.m_iID);
        fields.Signed("m_iFaceStart", range.m_iFaceStart);
        fields.Signed("m_iFaceCount", range.m_iFaceCount);
    });
}

void CTriMesh::DumpTable(CHTMLTables& tables)
{
    CGeometry::DumpTable(tables);
    tables.OwnFields<CTriMesh, CGeometry>(*this);
}

uint64_t CTriMesh::GetMemoryUsed() const
{
    const size_t words = m_kTriangleMtlID.size() + m_kSmoothFlag.size() + m_kXYZTriIndex.size() +
                         m_kNormalTriIndex.size() + m_kColorTriIndex.size() + m_kVertexTriIndex.size();
    return CGeometry::GetMemoryUsed() + 48 + (words + m_apkUVWMap.size()) * sizeof(uint32_t) +
           m_kAttributeRanges.size() * sizeof(AttributeRange);
}

void CTriMesh::AppendBindOrder(std::vector<CObject*>& order)
{
    for (const auto& map : m_apkUVWMap)
        order.push_back(map.Get());
    CGeometry::AppendBindOrder(order);
}

bool CTriMesh::Update(float time)
{
    CGeometry::Update(time);
    for (const auto& map : m_apkUVWMap)
    {
        if (map)
            map->Update(time);
    }
    return true;
}

bool CTriMesh::UpdateRange(uint32_t range, float time)
{
    CGeometry::UpdateRange(range, time);
    for (const auto& map : m_apkUVWMap)
    {
        if (map)
            map->UpdateRange(range, time);
    }
    return true;
}

void CTriMesh::Render(CRenderer& renderer)
{
    renderer.DrawTriMesh(*this);
}

void CTriMesh::UpdateWorldNormals()
{
    const std::span<Vec3> normals = WorldNormalBuffer();
    if (normals.empty() || m_bNormalsValid)
        return;
    if (!m_bWorldValid)
        UpdateWorldPoints();
    const std::span<const Vec3> points = WorldXYZBuffer();
    std::ranges::fill(normals, kVec3Zero);
    const size_t corners = std::min(m_kXYZTriIndex.size(), m_kNormalTriIndex.size());
    for (size_t corner = 0; corner + 3 <= corners; corner += 3)
    {
        const uint32_t* p = &m_kXYZTriIndex[corner];
        if (std::max({p[0], p[1], p[2]}) >= points.size())
            continue;
        // Not normalized: this weights by twice the triangle's area.
        const Vec3 normal = Vec3Cross(points[p[1]] - points[p[0]], points[p[2]] - points[p[0]]);
        for (size_t k = corner; k < corner + 3; ++k)
        {
            if (m_kNormalTriIndex[k] < normals.size())
                normals[m_kNormalTriIndex[k]] = normals[m_kNormalTriIndex[k]] + normal;
        }
    }
    for (Vec3& normal : normals)
        normal = Vec3Normalized(normal);
    m_bNormalsValid = true;
}

bool CTriMesh::SetTriangleQuantity(int32_t count)
{
    const int64_t corners = int64_t{3} * count;
    std::vector<uint32_t> points;
    std::vector<uint32_t> normals;
    std::vector<uint32_t> colors;
    if (count < 1 || !MakeBlock(points, XYZBuffer().empty() ? 0 : corners) ||
        !MakeBlock(normals, NormalBuffer().empty() ? 0 : corners) ||
        !MakeBlock(colors, ColorBuffer().empty() ? 0 : corners))
        return false;
    m_kVertexTriIndex.clear();
    m_kTriangleMtlID.clear();
    m_kSmoothFlag.clear();
    m_apkUVWMap.clear();
    m_iTriangleCount = count;
    m_kXYZTriIndex = std::move(points);
    m_kNormalTriIndex = std::move(normals);
    m_kColorTriIndex = std::move(colors);
    return true;
}

bool CTriMesh::CreateTriangleMtlID()
{
    return MakeBlock(m_kTriangleMtlID, m_iTriangleCount) && m_iTriangleCount > 0;
}

bool CTriMesh::CreateSmoothFlag()
{
    return MakeBlock(m_kSmoothFlag, m_iTriangleCount) && m_iTriangleCount > 0;
}

void CTriMesh::BuildVertexTable()
{
    if (m_iTriangleCount < 1)
        return;
    const size_t cornerCount = size_t{3} * static_cast<size_t>(m_iTriangleCount);
    IndexLists lists;
    for (const auto* list : {&m_kXYZTriIndex, &m_kNormalTriIndex, &m_kColorTriIndex})
    {
        if (!list->empty())
            lists.emplace_back(*list);
    }
    std::vector<CTriMeshUVWMap*> maps;
    for (const auto& map : m_apkUVWMap)
    {
        // A map has its own triangle count. If it is too short, it has no coordinates for the last corners.
        if (!map || map->UVWTriIndexBuffer().size() < cornerCount)
            continue;
        maps.push_back(map.Get());
        lists.emplace_back(map->UVWTriIndexBuffer());
    }
    if (lists.empty())
        return; // a triangle count without a list

    m_kVertexTriIndex.resize(cornerCount);
    const std::vector<uint32_t> cornerOf = NumberCorners(lists, m_kVertexTriIndex);
    SetVertexCount(cornerOf.size(), !m_kXYZTriIndex.empty(), !m_kNormalTriIndex.empty(),
                   !m_kColorTriIndex.empty());
    TakeIndices(m_kXYZTriIndex, cornerOf, VertexXYZIndex());
    TakeIndices(m_kNormalTriIndex, cornerOf, VertexNormalIndex());
    TakeIndices(m_kColorTriIndex, cornerOf, VertexColorIndex());
    for (CTriMeshUVWMap* map : maps)
    {
        map->SetVertexCount(cornerOf.size());
        TakeIndices(map->UVWTriIndexBuffer(), cornerOf, map->VertexUVWMap());
    }
}

} // namespace gw
