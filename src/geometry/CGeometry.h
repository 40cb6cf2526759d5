#pragma once

#include "CSpatial.h"

#include <array>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

class CMaterialBase;

/// A spatial with points, normals and colours. The model buffers stay untouched: each update makes a world
/// copy of them, controls deform that copy, and whoever draws reads it. Files may name points and normals
/// that there are not, so every index is checked by those who follow it.
class CGeometry : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    ~CGeometry() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    /// Copies the model points, runs the controls, and brings to the world what they left in model space.
    bool Update(float time) override;
    /// Copies the model points and passes the call on; points stay in model space and normals as they are.
    bool UpdateRange(uint32_t range, float time) override;
    void UpdateBound() override;
    /// Keeps what is in force in the slots of this geometry.
    void ApplyRenderStates(RenderStateStack& stack) override;

    virtual void UpdateWorldNormals() {}
    /// Takes the world points from model to world space, as they stand.
    virtual void UpdateWorldPoints();

    /// Sizes model and world points; contents and material ids are lost. Returns false, and changes nothing,
    /// below 1 or if there is not enough memory, as all sizing does.
    bool SetPointCount(int32_t count);
    /// Sizes model and world normals; contents are lost.
    bool SetNormalCount(int32_t count);
    /// Sizes the colours; contents are lost.
    bool SetColorCount(int32_t count);
    /// Gives each point a material id of 0; false when there are no points.
    bool CreateXYZMtl();

    // Buffers under the names that they have always had; empty where there is no block.

    std::span<Vec3> XYZBuffer() { return m_kXYZ; }                     ///< model space
    std::span<Vec3> WorldXYZBuffer() { return m_kWorldXYZ; }           ///< as many as XYZBuffer
    std::span<uint32_t> XYZMtl() { return m_kXYZMtl; }                 ///< a material id for each point
    std::span<Vec3> NormalBuffer() { return m_kNormal; }               ///< model space
    std::span<Vec3> WorldNormalBuffer() { return m_kWorldNormal; }     ///< as many as NormalBuffer
    std::span<Vec3> ColorBuffer() { return m_kColor; }                 ///< red, green, blue
    std::span<uint32_t> VertexXYZIndex() { return m_kVertexXYZIndex; } ///< for each render vertex, its point
    std::span<uint32_t> VertexNormalIndex() { return m_kVertexNormalIndex; } ///< its normal
    std::span<uint32_t> VertexColorIndex() { return m_kVertexColorIndex; }   ///< its colour
    /// Render vertices as told by the file or the last vertex table. The index lists above have as many
    /// entries or none.
    int32_t GetVertexQuantity() const { return m_iVertexCount; }

    CMaterialBase* GetMaterial() const;
    void SetMaterial(CMaterialBase* material);
    /// What the last render state walk left here, or null.
    CRenderState* GetRenderState(size_t type) const { return m_aspkRenderState[type].Get(); }

    bool m_bBoneMesh = false;     ///< stored and copied only
    bool m_bNormalsValid = false; ///< world normals are current
    bool m_bWorldValid = false;   ///< world points are in world space; a control that puts them there sets it
    bool m_bAutoNormals = true;   ///< each update computes the world normals

protected:
    CGeometry();
    CGeometry(const CGeometry& source);
    void CloneHeld(CCloneMap& map, CObject& copy) override;
    void AppendBindOrder(std::vector<CObject*>& order) override;
    /// Gives the world at least so many points, for a class that writes them itself.
    void GrowWorldPoints(size_t count);
    /// Sizes the index lists of the render vertices: those asked for get `count` entries, the others none.
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
    // Counts as files have them: they may stand without a block, and then bound nothing.
    int32_t m_iNormalCount = 0;
    int32_t m_iColorCount = 0;
    int32_t m_iVertexCount = 0;
};

} // namespace gw
