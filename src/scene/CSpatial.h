#pragma once

#include "BoundSphere.h"
#include "CObject.h"
#include "CRenderState.h"
#include "Mat4.h"

#include <vector>

namespace gw {

class CTriMesh;

/// Receives geometry from the render walk.
class CRenderer
{
public:
    virtual ~CRenderer() = default;
    virtual void DrawTriMesh(CTriMesh& mesh) = 0;
};

/// An object with a position in space. World matrix and bound are valid after UpdateScene, and stale after
/// m_kMatrix changes until the next UpdateScene. They are not stored in files.
class CSpatial : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CSpatial();
    CSpatial(const CSpatial& source);
    ~CSpatial() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    bool UpdateRange(uint32_t range, float time) override;

    virtual void Render(CRenderer&) {}
    /// Runs the control chain and computes the world matrix, unless two or more controls changed the
    /// transform: then the world matrix keeps its old value.
    virtual void UpdateTransform(float time);
    virtual void UpdateBound() = 0;
    virtual void ApplyRenderStates(RenderStateStack& stack) = 0;

    /// Updates transforms, then controls, then bounds of this subtree to a time; with `upward`, the bounds of
    /// the ancestors too.
    void UpdateScene(float time, bool upward);
    /// Pushes this object's states, or without a stack those of the whole parent chain on a new one; applies
    /// the states in effect, then pops.
    void PushAndApply(RenderStateStack* stack);
    /// Attaches a state. At most one state per type is kept; returns the replaced one, or null.
    Ref<CRenderState> AttachRenderState(CRenderState& state);

    CSpatial* GetParent() const { return m_pkParent; }
    /// Sets the parent, without counting a reference. Called by the parent.
    void SetParent(CSpatial* parent) { m_pkParent = parent; }

    Mat4 m_kMatrix = kMat4Identity;      ///< relative to the parent
    Mat4 m_kWorldMatrix = kMat4Identity; ///< m_kMatrix · parent's m_kWorldMatrix
    BoundSphere m_kBound;                ///< in world space
    bool m_bStoredFlag = true;           ///< stored and copied only
    bool m_bForceCull = false;           ///< the render walk skips this subtree

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;
    void AppendBindOrder(std::vector<CObject*>& order) override;
    /// Computes the world matrix from the local one and the parent's.
    void UpdateWorldMatrix();

private:
    void PushChain(RenderStateStack& stack);
    void PopChain(RenderStateStack& stack);

    CSpatial* m_pkParent = nullptr;
    std::vector<Held<CRenderState>> m_pkRenderStates; // newest first
};

} // namespace gw
