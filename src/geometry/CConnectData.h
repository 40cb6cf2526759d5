#pragma once

#include "CObject.h"
#include "Watch.h"

#include <cstdint>
#include <vector>

namespace gw {

class CTriMesh;

/// A seam between two meshes: pairs of points that must coincide, with the normals that meet there. A control
/// on each mesh reports when it has reached a time; once both have, the seam is closed.
class CConnectData : public CObject
{
public:
    /// The indices of the normals that meet at a pair's point.
    using NormalGroup = std::vector<uint32_t>;

    /// One side of the seam. The points of both sides are paired index by index.
    struct Side
    {
        Watch<CTriMesh> m_pkMesh;
        std::vector<uint32_t> m_kPoints;
        std::vector<NormalGroup> m_kGroups; ///< one per pair
        float m_fTime = -1.0f;              ///< of the mesh's last update
    };

    static const CRTTI ms_kRTTI;

    CConnectData();
    CConnectData(const CConnectData& source);
    ~CConnectData() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Closes the seam in the world buffers of both meshes. Returns false until both have reached the time.
    bool Update(float time) override;

    /// Records that a mesh has reached a time.
    void Reach(const CObject& mesh, float time);

    Side m_kFirst;
    Side m_kSecond;

private:
    void JoinPoints(size_t pair);
    void JoinNormals(size_t pair);
};

} // namespace gw
