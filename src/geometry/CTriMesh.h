#pragma once

#include "CGeometry.h"

namespace gw {

class CTriMeshUVWMap;

/// A run of triangles with one attribute. Carried through files and copies; nothing here computes any.
struct AttributeRange
{
    int32_t m_iID = 0;
    int32_t m_iFaceStart = 0;
    int32_t m_iFaceCount = 0;
};

/// Triangles with separate index lists for points, normals, colours and texture coordinates, and the flat
/// table of render vertices that follows from them. A mesh without triangles is legal.
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
    /// Sums the triangles' normals, weighted by area, and normalises; a normal that only flat triangles touch
    /// is zero.
    void UpdateWorldNormals() override;

    /// Drops all triangles with their lists and maps, then makes index lists for the blocks that are there:
    /// points, normals, colours. Returns false, and changes nothing, below 1 or if there is not enough
    /// memory.
    bool SetTriangleQuantity(int32_t count);
    /// Gives each triangle a material id, or a smoothing mask, of 0; false when there are no triangles.
    bool CreateTriangleMtlID();
    bool CreateSmoothFlag();
    /// Makes each distinct combination of a corner's indices one render vertex, numbered in the order of the
    /// combinations as signed numbers. To be run when the index lists are final.
    void BuildVertexTable();

    /// As told by the file or the last sizing. The lists below have as many entries, three times as many, or
    /// none.
    int32_t GetTriangleQuantity() const { return m_iTriangleCount; }
    std::span<uint32_t> TriangleMtlID() { return m_kTriangleMtlID; }   ///< one for each triangle
    std::span<uint32_t> SmoothFlag() { return m_kSmoothFlag; }         ///< smoothing groups of each triangle
    std::span<uint32_t> XYZTriIndexBuffer() { return m_kXYZTriIndex; } ///< three points for each triangle
    std::span<uint32_t> NormalTriIndexBuffer() { return m_kNormalTriIndex; } ///< three normals
    std::span<uint32_t> ColorTriIndexBuffer() { return m_kColorTriIndex; }   ///< three colours
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
    int32_t m_iTriangleCount = 0; // as files have it: it may stand without a block, and then bounds nothing
};

} // namespace gw
