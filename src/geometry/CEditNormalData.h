#pragma once

#include "CBitArray.h"
#include "CObject.h"
#include "Watch.h"

#include <span>
#include <vector>

namespace gw {

class CTriMesh;
struct NormalPlace;
struct Vec3;

/// Smooths selected normals across meshes: where points of different meshes are close together, their normals
/// become equal. The last mesh to be updated triggers the work.
class CEditNormalData : public CObject
{
public:
    struct Record
    {
        Watch<CTriMesh> m_pkMesh;
        CBitArray m_kNormals; ///< selected normals of the mesh
    };

    static const CRTTI ms_kRTTI;

    CEditNormalData();
    CEditNormalData(const CEditNormalData& source);
    ~CEditNormalData() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Returns false until the normals of all meshes are up to date.
    bool Update(float time) override;

    std::vector<Record> m_kMeshes;
    bool m_bEnabled = true;    ///< stored and copied only
    float m_fThreshold = 0.0f; ///< points closer than this count as one place

private:
    std::vector<Vec3> SmoothedNormals(std::span<const NormalPlace> places) const;
    void WriteNormals(std::span<const NormalPlace> places, std::span<const Vec3> normals);
};

} // namespace gw
