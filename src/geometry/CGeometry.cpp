// Points, normals and colors with their world copies. Sizes come from files and can be anything, so every
// allocation can fail, and counts without data are kept but never used as limits.

#include "CGeometry.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "CMaterialBase.h"
#include "MakeBlock.h"

#include <algorithm>
#include <utility>

namespace gw {

const CRTTI CGeometry::ms_kRTTI{"CGeometry", &CSpatial::ms_kRTTI};

CGeometry::CGeometry() = default;
CGeometry::CGeometry(const CGeometry& source) = default;
CGeometry::~CGeometry() = default;

void CGeometry::Fields(CFieldArchive& archive)
{
    CSpatial::Fields(archive);
    archive.SignedBlock("XYZBuffer", m_kXYZ);
    archive.OptionalBlock("XYZMtl", m_kXYZMtl, static_cast<int64_t>(m_kXYZ.size()));
    archive.Signed("normal count", m_iNormalCount);
    archive.OptionalBlock("NormalBuffer", m_kNormal, m_iNormalCount);
    archive.Signed("colour count", m_iColorCount);
    archive.OptionalBlock("ColorBuffer", m_kColor, m_iColorCount);
    archive.Signed("render vertex count", m_iVertexCount);
    archive.OptionalBlock("VertexXYZIndex", m_kVertexXYZIndex, m_iVertexCount);
    archive.OptionalBlock("VertexNormalIndex", m_kVertexNormalIndex, m_iVertexCount);
    archive.OptionalBlock("VertexColorIndex", m_kVertexColorIndex, m_iVertexCount);
    archive.Link("m_spkMaterialBase", m_spkMaterialBase);
    archive.Bool("m_bBoneMesh", m_bBoneMesh);
    if (!archive.IsReading())
        return;
    m_kWorldXYZ.resize(m_kXYZ.size());
    m_kWorldNormal.resize(m_kNormal.size());
}

void CGeometry::DumpTable(CHTMLTables& tables)
{
    CSpatial::DumpTable(tables);
    tables.OwnFields<CGeometry, CSpatial>(*this);
}

uint64_t CGeometry::GetMemoryUsed() const
{
    const size_t vectors =
        m_kXYZ.size() + m_kWorldXYZ.size() + m_kNormal.size() + m_kWorldNormal.size() + m_kColor.size();
    const size_t words = m_kXYZMtl.size() + m_kVertexXYZIndex.size() + m_kVertexNormalIndex.size() +
                         m_kVertexColorIndex.size();
    return CSpatial::GetMemoryUsed() + 88 + vectors * sizeof(Vec3) + words * sizeof(uint32_t);
}

void CGeometry::CloneHeld(CCloneMap& map, CObject& copy)
{
    CSpatial::CloneHeld(map, copy);
    CGeometry& geometry = static_cast<CGeometry&>(copy);
    for (size_t type = 0; type < kRenderStateTypes; ++type)
    {
        if (m_aspkRenderState[type])
            geometry.m_aspkRenderState[type] =
                static_cast<CRenderState*>(m_aspkRenderState[type]->Clone(map));
    }
}

void CGeometry::AppendBindOrder(std::vector<CObject*>& order)
{
    for (const auto& state : m_aspkRenderState)
        order.push_back(state.Get());
    order.push_back(m_spkMaterialBase.Get());
    CSpatial::AppendBindOrder(order);
}

bool CGeometry::Update(float time)
{
    m_bNormalsValid = false;
    m_bWorldValid = false;
    m_kWorldXYZ = m_kXYZ; // keeps the allocated memory
    CSpatial::Update(time);
    if (!m_bWorldValid)
        UpdateWorldPoints();
    if (m_bAutoNormals && !m_bNormalsValid)
        UpdateWorldNormals();
    m_bNormalsValid = true;
    return true;
}

bool CGeometry::UpdateRange(uint32_t range, float time)
{
    m_bWorldValid = false;
    m_kWorldXYZ = m_kXYZ;
    return CSpatial::UpdateRange(range, time);
}

void CGeometry::UpdateWorldPoints()
{
    for (Vec3& point : m_kWorldXYZ)
        point = TransformCoord(point, m_kWorldMatrix);
    m_bWorldValid = true;
}

void CGeometry::UpdateBound()
{
    m_kBound = BoundOfPoints(m_kWorldXYZ);
}

void CGeometry::ApplyRenderStates(RenderStateStack& stack)
{
    for (size_t type = 0; type < kRenderStateTypes; ++type)
        m_aspkRenderState[type] = stack.Top(type);
}

bool CGeometry::SetPointCount(int32_t count)
{
    std::vector<Vec3> model;
    std::vector<Vec3> world;
    if (count < 1 || !MakeBlock(model, count) || !MakeBlock(world, count))
        return false;
    m_kXYZ = std::move(model);
    m_kWorldXYZ = std::move(world);
    m_kXYZMtl.clear(); // one id per point, or empty
    return true;
}

bool CGeometry::SetNormalCount(int32_t count)
{
    std::vector<Vec3> model;
    std::vector<Vec3> world;
    if (count < 1 || !MakeBlock(model, count) || !MakeBlock(world, count))
        return false;
    m_iNormalCount = count;
    m_kNormal = std::move(model);
    m_kWorldNormal = std::move(world);
    return true;
}

bool CGeometry::SetColorCount(int32_t count)
{
    if (count < 1 || !MakeBlock(m_kColor, count))
        return false;
    m_iColorCount = count;
    return true;
}

bool CGeometry::CreateXYZMtl()
{
    return !m_kXYZ.empty() && MakeBlock(m_kXYZMtl, static_cast<int64_t>(m_kXYZ.size()));
}

void CGeometry::GrowWorldPoints(size_t count)
{
    m_kWorldXYZ.resize(std::max(m_kWorldXYZ.size(), count), kVec3Zero);
}

void CGeometry::SetVertexCount(size_t count, bool points, bool normals, bool colors)
{
    m_iVertexCount = static_cast<int32_t>(count);
    m_kVertexXYZIndex.resize(points ? count : 0);
    m_kVertexNormalIndex.resize(normals ? count : 0);
    m_kVertexColorIndex.resize(colors ? count : 0);
}

CMaterialBase* CGeometry::GetMaterial() const
{
    return m_spkMaterialBase.Get();
}

void CGeometry::SetMaterial(CMaterialBase* material)
{
    m_spkMaterialBase = material;
}

} // namespace gw
