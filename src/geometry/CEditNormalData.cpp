// Smooths normals across meshes. All sums are computed from the old normals before any is written, so the
// result does not depend on the order of the meshes.

#include "CEditNormalData.h"

#include "CFieldArchive.h"
#include "CPlaceGrid.h"
#include "CTriMesh.h"

#include <algorithm>

namespace gw {

const CRTTI CEditNormalData::ms_kRTTI{"CEditNormalData", &CObject::ms_kRTTI};

namespace {

using Record = CEditNormalData::Record;
using Places = std::vector<NormalPlace>;

// Appends each selected normal of a mesh once, at the first corner that uses it.
void AppendPlaces(Places& places, const Record& record, size_t index)
{
    CTriMesh& mesh = *record.m_pkMesh.Get();
    const std::span<const uint32_t> normalAt = mesh.NormalTriIndexBuffer();
    const std::span<const uint32_t> pointAt = mesh.XYZTriIndexBuffer();
    const std::span<const Vec3> normals = mesh.WorldNormalBuffer();
    const std::span<const Vec3> points = mesh.WorldXYZBuffer();
    CBitArray open = record.m_kNormals;
    for (size_t corner = 0; corner < std::min(normalAt.size(), pointAt.size()); ++corner)
    {
        const uint32_t normal = normalAt[corner];
        if (!open.Test(normal) || normal >= normals.size() || pointAt[corner] >= points.size())
            continue;
        open.Clear(normal);
        places.push_back({index, normal, points[pointAt[corner]], normals[normal]});
    }
}

// A selected normal that no corner uses stays zero.
void ClearSelected(const Record& record)
{
    const std::span<Vec3> normals = record.m_pkMesh->WorldNormalBuffer();
    for (size_t normal = 0; normal < normals.size(); ++normal)
    {
        if (record.m_kNormals.Test(normal))
            normals[normal] = kVec3Zero;
    }
}

} // namespace

CEditNormalData::CEditNormalData() = default;
CEditNormalData::CEditNormalData(const CEditNormalData& source) = default;
CEditNormalData::~CEditNormalData() = default;

CObject* CEditNormalData::CreateClone() const
{
    return new CEditNormalData(*this);
}

void CEditNormalData::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Array("m_kMeshes", m_kMeshes, [](CFieldArchive& fields, Record& record) {
        fields.PlainLink("m_pkMesh", record.m_pkMesh);
        record.m_kNormals.Fields(fields, "m_kNormals");
    });
    archive.Bool("m_bEnabled", m_bEnabled);
    archive.Float("m_fThreshold", m_fThreshold);
}

uint64_t CEditNormalData::GetMemoryUsed() const
{
    uint64_t bytes = CObject::GetMemoryUsed() + 20;
    for (const Record& record : m_kMeshes)
        bytes += 8 + record.m_kNormals.MemoryUsed();
    return bytes;
}

bool CEditNormalData::Update(float time)
{
    CObject::Update(time);
    const auto isBehind = [](const Record& record) {
        return record.m_pkMesh && !record.m_pkMesh->m_bNormalsValid;
    };
    if (std::ranges::any_of(m_kMeshes, isBehind))
        return false;
    Places places;
    for (size_t i = 0; i < m_kMeshes.size(); ++i)
    {
        if (m_kMeshes[i].m_pkMesh)
            AppendPlaces(places, m_kMeshes[i], i);
    }
    WriteNormals(places, SmoothedNormals(places));
    return true;
}

// Computed only from the previous normals of all meshes.
std::vector<Vec3> CEditNormalData::SmoothedNormals(std::span<const NormalPlace> places) const
{
    const CPlaceGrid grid(places, m_fThreshold);
    std::vector<Vec3> normals;
    normals.reserve(places.size());
    for (const NormalPlace& place : places)
        normals.push_back(Vec3Normalized(place.m_kNormal + grid.SumNear(place)));
    return normals;
}

void CEditNormalData::WriteNormals(std::span<const NormalPlace> places, std::span<const Vec3> normals)
{
    for (const Record& record : m_kMeshes)
    {
        if (!record.m_pkMesh)
            continue;
        ClearSelected(record);
        ++record.m_pkMesh->m_uiChangeStamp;
    }
    for (size_t i = 0; i < places.size(); ++i)
        m_kMeshes[places[i].m_uiMesh].m_pkMesh->WorldNormalBuffer()[places[i].m_uiNormal] = normals[i];
}

} // namespace gw
