#pragma once

#include "CSpatial.h"

namespace gw {

/// A spatial with children. A skeleton is a tree of these, one per bone.
class CNode : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    /// The argument is the number of spare slots when SetChildAt enlarges the child array.
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

    /// A copy of the tree's nodes alone: no meshes, no controls, child slots packed. The map keeps what is
    /// shared shared.
    virtual CNode* CopySkeleton(CCloneMap& map);
    virtual CNode* CopySkeleton();

    /// The number of slots, null ones included. Every loop over children must pass over null slots.
    size_t GetChildCount() const { return m_kChild.size(); }
    /// The child in a slot, or null for an empty slot and for an index out of range.
    Ref<CSpatial> GetChild(size_t index) const;
    /// The same without a count, for those who only look.
    CSpatial* ChildAt(size_t index) const { return m_kChild[index].Get(); }
    /// Puts the child into the first null slot, or grows by two slots. False for null.
    bool AttachChild(CSpatial* child);
    /// Empties every slot that holds the child; the array does not shrink. False for null only.
    bool DetachChild(CSpatial* child);
    /// Places a child, null included, and answers the previous occupant.
    Ref<CSpatial> SetChildAt(size_t index, CSpatial* child);
    /// Whether no child is a node: a leaf bone.
    bool HasNoNodeChild() const;
    /// The parent when that is a node, else null.
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

/// A node that files may ask for and that behaves as any other.
class CBillboardNode : public CNode
{
public:
    static const CRTTI ms_kRTTI;

    using CNode::CNode;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
};

} // namespace gw
