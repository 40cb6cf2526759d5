#pragma once

#include "CSpatial.h"

namespace gw {

/// A spatial with children. A skeleton is a tree of these, one per bone.
class CNode : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    /// `growBy` is the number of spare slots that SetChildAt adds when it enlarges the child array.
    explicit CNode(uint32_t growBy = 1);
    CNode(const CNode& source);
    ~CNode() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void WriteHTMLFrames(const std::string& folder) override;
    void DumpTable(CHTMLTables& tables) override;
    void Link(COrrinStream& stream, CLinkRecord& record) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    bool UpdateRange(uint32_t range, float time) override;
    void Render(CRenderer& renderer) override;
    void UpdateTransform(float time) override;
    void UpdateBound() override;
    void ApplyRenderStates(RenderStateStack& stack) override;

    /// Copies only the nodes of the tree: no meshes or controls, and child slots packed. The map keeps shared
    /// nodes shared.
    virtual CNode* CopySkeleton(CCloneMap& map);
    virtual CNode* CopySkeleton();

    /// Returns the number of slots, including null ones, which every loop over children must skip.
    size_t GetChildCount() const { return m_kChild.size(); }
    /// Returns the child in a slot, or null for an empty slot or an index out of range.
    Ref<CSpatial> GetChild(size_t index) const;
    /// Returns the child in a slot without counting a reference. The index must be in range.
    CSpatial* ChildAt(size_t index) const { return m_kChild[index].Get(); }
    /// Puts a child into the first null slot, adding two slots if there is none. Returns false for null.
    bool AttachChild(CSpatial* child);
    /// Empties every slot that holds the child; the array does not shrink. Returns false only for null.
    bool DetachChild(CSpatial* child);
    /// Sets a slot to a child or null and returns the previous child.
    Ref<CSpatial> SetChildAt(size_t index, CSpatial* child);
    /// Returns whether no child is a node, that is, whether this is a leaf bone.
    bool HasNoNodeChild() const;
    /// Returns the parent if it is a node, otherwise null.
    CNode* GetParentNode() const { return RecordCast<CNode>(GetParent()); }

    uint32_t m_uiGrowBy;
    bool m_bNodeFlagA = true; ///< stored and copied only
    bool m_bNodeFlagB = true; ///< stored and copied only

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;
    void AppendBindOrder(std::vector<CObject*>& order) override;

private:
    std::vector<Held<CSpatial>> m_kChild;
};

/// A node class that files may contain; it behaves like any other node.
class CBillboardNode : public CNode
{
public:
    static const CRTTI ms_kRTTI;

    using CNode::CNode;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
};

} // namespace gw
