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

/// Smooths selected normals across meshes: where points of different meshes are near each other, their
/// normals become one. The last mesh that an update reaches starts the work.
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
    /// False until the normals of all meshes are current.
    bool Update(float time) override;

    std::vector<Record> m_kMeshes;
    bool m_bEnabled = true;    ///< stored and copied only
    float m_fThreshold = 0.0f; ///< points nearer than this count as one place

private:
    std::vector<Vec3> SmoothedNormals(std::span<const NormalPlace> places) const;
    void WriteNormals(std::span<const NormalPlace> places, std::span<const Vec3> normals);
};

} // namespace gw
