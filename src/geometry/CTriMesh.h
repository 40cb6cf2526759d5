#pragma once

#include "CGeometry.h"

namespace gw {

class CTriMeshUVWMap;

/// A range of triangles with one attribute. Preserved in files and copies, never computed here.
struct AttributeRange
{
    int32_t m_iID = 0;
    int32_t m_iFaceStart = 0;
    int32_t m_iFaceCount = 0;
};

/// Triangles with separate index lists for points, normals, colors and texture coordinates, and the derived
/// table of render vertices. A mesh may have no triangles.
class CTriMesh : public CGeometry
{
public:
    static const CRTTI ms_kRTTI;

    CTriMesh();
    CTriMesh(const CTriMesh& source);
    ~CTriMesh() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    bool UpdateRange(uint32_t range, float time) override;
    void Render(CRenderer& renderer) override;
    /// Computes each normal as the area-weighted sum of its triangles' normals, normalized. A normal used
    /// only by degenerate triangles is zero.
    void UpdateWorldNormals() override;

    /// Discards all triangles with their lists and maps, then creates index lists for the existing blocks:
    /// points, normals, colors. Returns false and changes nothing if the count is below 1 or there is not
    /// enough memory.
    bool SetTriangleQuantity(int32_t count);
    /// Assigns each triangle a material id, or a smoothing mask, of 0; false if there are no triangles.
    bool CreateTriangleMtlID();
    bool CreateSmoothFlag();
    /// Makes each distinct combination of a corner's indices one render vertex, sorted by the combinations as
    /// signed numbers. Call it when the index lists are final.
    void BuildVertexTable();

    /// Returns the triangle count as stored in the file or set last. The lists below have that many entries,
    /// three times as many, or none.
    int32_t GetTriangleQuantity() const { return m_iTriangleCount; }
    std::span<uint32_t> TriangleMtlID() { return m_kTriangleMtlID; }   ///< one per triangle
    std::span<uint32_t> SmoothFlag() { return m_kSmoothFlag; }         ///< smoothing groups per triangle
    std::span<uint32_t> XYZTriIndexBuffer() { return m_kXYZTriIndex; } ///< three points per triangle
    std::span<uint32_t> NormalTriIndexBuffer() { return m_kNormalTriIndex; } ///< three normals
    std::span<uint32_t> ColorTriIndexBuffer() { return m_kColorTriIndex; }   ///< three colors
    std::span<uint32_t> VertexTriIndexBuffer() { return m_kVertexTriIndex; } ///< three render vertices

    std::vector<Held<CTriMeshUVWMap>> m_apkUVWMap; ///< entries may be null
    std::vector<AttributeRange> m_kAttributeRanges;

protected:
    void AppendBindOrder(std::vector<CObject*>& order) override;

private:
    std::vector<uint32_t> m_kTriangleMtlID;
    std::vector<uint32_t> m_kSmoothFlag;
    std::vector<uint32_t> m_kXYZTriIndex;
    std::vector<uint32_t> m_kNormalTriIndex;
    std::vector<uint32_t> m_kColorTriIndex;
    std::vector<uint32_t> m_kVertexTriIndex;
    int32_t m_iTriangleCount = 0; // as stored in files; without a block it limits nothing
};

} // namespace gw
