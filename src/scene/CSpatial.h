#pragma once

#include "BoundSphere.h"
#include "CObject.h"
#include "CRenderState.h"
#include "Mat4.h"

#include <vector>

namespace gw {

class CTriMesh;

/// What the render walk hands geometry to.
class CRenderer
{
public:
    virtual ~CRenderer() = default;
    virtual void DrawTriMesh(CTriMesh& mesh) = 0;
};

/// An object with a place in space. World matrix and bound are valid after an UpdateScene and stale after any
/// change of m_kMatrix until the next one; files do not store them.
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
    /// Runs the controls of the chain and computes the world matrix, unless two or more of them rewrote the
    /// transform: then the world matrix keeps its old value.
    virtual void UpdateTransform(float time);
    virtual void UpdateBound() = 0;
    virtual void ApplyRenderStates(RenderStateStack& stack) = 0;

    /// Brings transforms, then controls, then bounds below here to a time; with `upward` also the ancestors'
    /// bounds.
    void UpdateScene(float time, bool upward);
    /// Pushes this object's states, or with null those of the whole parent chain on a new stack, applies what
    /// is in force and pops again.
    void PushAndApply(RenderStateStack* stack);
    /// At most one state of each type: the one replaced is answered, or null.
    Ref<CRenderState> AttachRenderState(CRenderState& state);

    CSpatial* GetParent() const { return m_pkParent; }
    /// For those who hold this object as a child; it takes no count.
    void SetParent(CSpatial* parent) { m_pkParent = parent; }

    Mat4 m_kMatrix = kMat4Identity;      ///< relative to the parent
    Mat4 m_kWorldMatrix = kMat4Identity; ///< m_kMatrix · parent's m_kWorldMatrix
    BoundSphere m_kBound;                ///< in the world
    bool m_bStoredFlag = true;           ///< stored and copied only
    bool m_bForceCull = false;           ///< the render walk skips this object with all below it

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;
    void AppendBindOrder(std::vector<CObject*>& order) override;
    /// World matrix from the local one and the parent's.
    void UpdateWorldMatrix();

private:
    void PushChain(RenderStateStack& stack);
    void PopChain(RenderStateStack& stack);

    CSpatial* m_pkParent = nullptr;
    std::vector<Held<CRenderState>> m_pkRenderStates; // newest first
};

} // namespace gw
