// Closes a seam: each pair of points moves to its middle, and the normals of the pair become their normalized
// sum. Indices come from files, so those out of range are skipped.

#include "CConnectData.h"

#include "CFieldArchive.h"
#include "CTriMesh.h"

namespace gw {

const CRTTI CConnectData::ms_kRTTI{"CConnectData", &CObject::ms_kRTTI};

namespace {

using Side = CConnectData::Side;

void GroupFields(CFieldArchive& archive, const char* name, std::vector<CConnectData::NormalGroup>& groups)
{
    archive.Array(name, groups, [](CFieldArchive& fields, CConnectData::NormalGroup& group) {
        fields.Block("normals", group);
    });
}

// Returns the point of a pair, or null if the file names a point that does not exist.
Vec3* PointOf(const Side& side, size_t pair)
{
    const std::span<Vec3> points = side.m_pkMesh->WorldXYZBuffer();
    const uint32_t point = side.m_kPoints[pair];
    return point < points.size() ? &points[point] : nullptr;
}

// Calls a function for each existing normal of a pair's group.
template <class F>
void ForEachNormal(const Side& side, size_t pair, F visit)
{
    if (pair >= side.m_kGroups.size())
        return;
    const std::span<Vec3> normals = side.m_pkMesh->WorldNormalBuffer();
    for (const uint32_t normal : side.m_kGroups[pair])
    {
        if (normal < normals.size())
            visit(normals[normal]);
    }
}

uint64_t MemoryUsed(const Side& side)
{
    uint64_t words = side.m_kPoints.size();
    for (const auto& group : side.m_kGroups)
        words += group.size();
    return 32 + words * sizeof(uint32_t) + side.m_kGroups.size() * 12;
}

} // namespace

CConnectData::CConnectData() = default;
CConnectData::CConnectData(const CConnectData& source) = default;
CConnectData::~CConnectData() = default;

CObject* CConnectData::CreateClone() const
{
    return new CConnectData(*this);
}

void CConnectData::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.PlainLink("first mesh", m_kFirst.m_pkMesh);
    archive.PlainLink("second mesh", m_kSecond.m_pkMesh);
    archive.Block("first points", m_kFirst.m_kPoints);
    archive.Block("second points", m_kSecond.m_kPoints);
    GroupFields(archive, "first groups", m_kFirst.m_kGroups);
    GroupFields(archive, "second groups", m_kSecond.m_kGroups);
}

uint64_t CConnectData::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + MemoryUsed(m_kFirst) + MemoryUsed(m_kSecond);
}

void CConnectData::Reach(const CObject& mesh, float time)
{
    for (Side* side : {&m_kFirst, &m_kSecond})
    {
        if (side->m_pkMesh.Get() == &mesh)
            side->m_fTime = time;
    }
}

bool CConnectData::Update(float time)
{
    CObject::Update(time);
    if (m_kFirst.m_fTime != time || m_kSecond.m_fTime != time || !m_kFirst.m_pkMesh || !m_kSecond.m_pkMesh)
        return false;
    ++m_kFirst.m_pkMesh->m_uiChangeStamp;
    ++m_kSecond.m_pkMesh->m_uiChangeStamp;
    const size_t pairs = std::min(m_kFirst.m_kPoints.size(), m_kSecond.m_kPoints.size());
    for (size_t pair = 0; pair < pairs; ++pair)
    {
        JoinPoints(pair);
        JoinNormals(pair);
    }
    return true;
}

// In pair order and in place: a point that is named twice moves twice.
void CConnectData::JoinPoints(size_t pair)
{
    Vec3* const a = PointOf(m_kFirst, pair);
    Vec3* const b = PointOf(m_kSecond, pair);
    if (a && b)
        *a = *b = (*a + *b) * 0.5f;
}

void CConnectData::JoinNormals(size_t pair)
{
    Vec3 sum = kVec3Zero;
    for (const Side* side : {&m_kFirst, &m_kSecond})
        ForEachNormal(*side, pair, [&](const Vec3& normal) { sum = sum + normal; });
    sum = Vec3Normalized(sum);
    for (const Side* side : {&m_kFirst, &m_kSecond})
        ForEachNormal(*side, pair, [&](Vec3& normal) { normal = sum; });
}

} // namespace gw
