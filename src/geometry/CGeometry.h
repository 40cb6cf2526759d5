#pragma once

#include "CSpatial.h"

#include <array>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

class CMaterialBase;

/// A spatial with points, normals and colors. Model buffers are not modified: each update makes a world copy,
/// controls deform that copy, and renderers read it. Files can refer to points and normals that do not exist,
/// so users of an index must check it.
class CGeometry : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    ~CGeometry() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    /// Copies the model points, runs the controls, and transforms to world space whatever they left in model
    /// space.
    bool Update(float time) override;
    /// Copies the model points and runs the base update; points stay in model space, normals unchanged.
    bool UpdateRange(uint32_t range, float time) override;
    void UpdateBound() override;
    /// Stores the render states in effect in the slots of this geometry.
    void ApplyRenderStates(RenderStateStack& stack) override;

    virtual void UpdateWorldNormals() {}
    /// Transforms the current world points from model to world space.
    virtual void UpdateWorldPoints();

    /// Sizes model and world points; contents and material ids are lost. Returns false and changes nothing if
    /// the count is below 1 or there is not enough memory, as do all functions that set a size.
    bool SetPointCount(int32_t count);
    /// Sizes model and world normals; contents are lost.
    bool SetNormalCount(int32_t count);
    /// Sizes the colors; contents are lost.
    bool SetColorCount(int32_t count);
    /// Assigns material id 0 to each point; false if there are no points.
    bool CreateXYZMtl();

    // Buffers, under the names that they have always had; empty if a block is missing.

    std::span<Vec3> XYZBuffer() { return m_kXYZ; }                     ///< model space
    std::span<Vec3> WorldXYZBuffer() { return m_kWorldXYZ; }           ///< same size as XYZBuffer
    std::span<uint32_t> XYZMtl() { return m_kXYZMtl; }                 ///< one material id per point
    std::span<Vec3> NormalBuffer() { return m_kNormal; }               ///< model space
    std::span<Vec3> WorldNormalBuffer() { return m_kWorldNormal; }     ///< same size as NormalBuffer
    std::span<Vec3> ColorBuffer() { return m_kColor; }                 ///< red, green, blue
    std::span<uint32_t> VertexXYZIndex() { return m_kVertexXYZIndex; } ///< the point of each render vertex
    std::span<uint32_t> VertexNormalIndex() { return m_kVertexNormalIndex; } ///< its normal
    std::span<uint32_t> VertexColorIndex() { return m_kVertexColorIndex; }   ///< its color
    /// Returns the number of render vertices, as stored in the file or set by the last vertex table. The
    /// index lists above have that many entries or none.
    int32_t GetVertexQuantity() const { return m_iVertexCount; }

    CMaterialBase* GetMaterial() const;
    void SetMaterial(CMaterialBase* material);
    /// Returns the state that the last render walk stored, or null.
    CRenderState* GetRenderState(size_t type) const { return m_aspkRenderState[type].Get(); }

    bool m_bBoneMesh = false;     ///< stored and copied only
    bool m_bNormalsValid = false; ///< world normals are current
    bool m_bWorldValid = false;   ///< world points are in world space; set by a control that moves them there
    bool m_bAutoNormals = true;   ///< each update recomputes the world normals

protected:
    CGeometry();
    CGeometry(const CGeometry& source);
    void CloneHeld(CCloneMap& map, CObject& copy) override;
    void AppendBindOrder(std::vector<CObject*>& order) override;
    /// Enlarges the world points to at least a count, for a class that writes them itself.
    void GrowWorldPoints(size_t count);
    /// Sizes the index lists of the render vertices: the selected ones to `count` entries, the others to
    /// none.
    void SetVertexCount(size_t count, bool points, bool normals, bool colors);

private:
    std::vector<Vec3> m_kXYZ;
    std::vector<Vec3> m_kWorldXYZ;
    std::vector<uint32_t> m_kXYZMtl;
    std::vector<Vec3> m_kNormal;
    std::vector<Vec3> m_kWorldNormal;
    std::vector<Vec3> m_kColor;
    std::vector<uint32_t> m_kVertexXYZIndex;
    std::vector<uint32_t> m_kVertexNormalIndex;
    std::vector<uint32_t> m_kVertexColorIndex;
    std::array<Held<CRenderState>, kRenderStateTypes> m_aspkRenderState;
    Held<CMaterialBase> m_spkMaterialBase;
    // Counts as stored in files. Without a block they limit nothing.
    int32_t m_iNormalCount = 0;
    int32_t m_iColorCount = 0;
    int32_t m_iVertexCount = 0;
};

} // namespace gw
