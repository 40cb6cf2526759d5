#pragma once

#include "CObject.h"
#include "Vec3.h"

#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// A set of texture coordinates of a mesh, with its own triangles.
class CTriMeshUVWMap : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    /// Sizes the coordinates; contents are lost. Returns false and changes nothing if the count is below 1 or
    /// there is not enough memory.
    bool SetUVWCount(int32_t count);
    /// Sizes the triangles' index list; contents are lost. Fails like SetUVWCount.
    bool SetTriangleQuantity(int32_t count);
    /// Sizes the list of render vertices, which a mesh fills when it builds its vertex table.
    void SetVertexCount(size_t count);

    // Empty if the block is missing.

    std::span<Vec3> UVWBuffer() { return m_kUVW; }
    std::span<uint32_t> VertexUVWMap() { return m_kVertexUVW; } ///< the coordinate of each render vertex
    std::span<uint32_t> UVWTriIndexBuffer() { return m_kUVWTriIndex; } ///< three coordinates per triangle
    /// Returns the triangle count as stored in the file or set last.
    int32_t GetTriangleQuantity() const { return m_iTriangleCount; }

private:
    std::vector<Vec3> m_kUVW;
    std::vector<uint32_t> m_kVertexUVW;
    std::vector<uint32_t> m_kUVWTriIndex;
    // Counts as stored in files. Without a block they limit nothing.
    int32_t m_iUVWCount = 0;
    int32_t m_iVertexCount = 0;
    int32_t m_iTriangleCount = 0;
};

} // namespace gw
