#pragma once

#include "CObject.h"
#include "Vec3.h"

#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// One set of texture coordinates of a mesh, with triangles of its own over them.
class CTriMeshUVWMap : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    /// Sizes the coordinates; contents are lost. Returns false, and changes nothing, below 1 or if there is
    /// not enough memory.
    bool SetUVWCount(int32_t count);
    /// Sizes the triangles' index list; contents are lost. Fails like SetUVWCount.
    bool SetTriangleQuantity(int32_t count);
    /// Sizes the list of render vertices, which a mesh fills when it builds its vertex table.
    void SetVertexCount(size_t count);

    // Empty where there is no block.

    std::span<Vec3> UVWBuffer() { return m_kUVW; }
    std::span<uint32_t> VertexUVWMap() { return m_kVertexUVW; } ///< for each render vertex, its coordinate
    std::span<uint32_t> UVWTriIndexBuffer()
    {
        return m_kUVWTriIndex;
    } ///< three coordinates for each triangle
    /// As told by the file or the last sizing.
    int32_t GetTriangleQuantity() const { return m_iTriangleCount; }

private:
    std::vector<Vec3> m_kUVW;
    std::vector<uint32_t> m_kVertexUVW;
    std::vector<uint32_t> m_kUVWTriIndex;
    // Counts as files have them: they may stand without a block, and then bound nothing.
    int32_t m_iUVWCount = 0;
    int32_t m_iVertexCount = 0;
    int32_t m_iTriangleCount = 0;
};

} // namespace gw
