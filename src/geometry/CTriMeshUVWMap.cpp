#include "CTriMeshUVWMap.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "MakeBlock.h"

namespace gw {

const CRTTI CTriMeshUVWMap::ms_kRTTI{"CTriMeshUVWMap", &CObject::ms_kRTTI};

CObject* CTriMeshUVWMap::CreateClone() const
{
    return new CTriMeshUVWMap(*this);
}

void CTriMeshUVWMap::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Signed("UVW count", m_iUVWCount);
    archive.OptionalBlock("UVWBuffer", m_kUVW, m_iUVWCount);
    archive.Signed("triangle quantity", m_iTriangleCount);
    archive.OptionalBlock("UVWTriIndexBuffer", m_kUVWTriIndex, int64_t{3} * m_iTriangleCount);
    archive.Signed("VertexUVWMap count", m_iVertexCount);
    archive.OptionalBlock("VertexUVWMap", m_kVertexUVW, m_iVertexCount);
}

void CTriMeshUVWMap::DumpTable(CHTMLTables& tables)
{
    CObject::DumpTable(tables);
    tables.OwnFields<CTriMeshUVWMap, CObject>(*this);
}

uint64_t CTriMeshUVWMap::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 24 + m_kUVW.size() * sizeof(Vec3) +
           (m_kUVWTriIndex.size() + m_kVertexUVW.size()) * sizeof(uint32_t);
}

bool CTriMeshUVWMap::SetUVWCount(int32_t count)
{
    if (count < 1 || !MakeBlock(m_kUVW, count))
        return false;
    m_iUVWCount = count;
    return true;
}

bool CTriMeshUVWMap::SetTriangleQuantity(int32_t count)
{
    if (count < 1 || !MakeBlock(m_kUVWTriIndex, int64_t{3} * count))
        return false;
    m_iTriangleCount = count;
    return true;
}

void CTriMeshUVWMap::SetVertexCount(size_t count)
{
    m_iVertexCount = static_cast<int32_t>(count);
    m_kVertexUVW.resize(count);
}

} // namespace gw
