// The scene tree. Child slots can be null, also in files, and keep their index when a child is removed:
// references by slot stay valid, and every walk skips empty slots.

#include "CNode.h"

#include "CFieldArchive.h"
#include "CHTMLDump.h"
#include "CHTMLTables.h"
#include "HTMLMarkup.h"

#include <algorithm>

namespace gw {

const CRTTI CNode::ms_kRTTI{"CNode", &CSpatial::ms_kRTTI};
const CRTTI CBillboardNode::ms_kRTTI{"CBillboardNode", &CNode::ms_kRTTI};

namespace {

constexpr uint32_t kMostSpareSlots = 4096; // a file must not be able to reserve arbitrary memory

} // namespace

CNode::CNode(uint32_t growBy) : m_uiGrowBy(growBy) {}

// The child array stays empty; cloning attaches the copied children.
CNode::CNode(const CNode& source)
    : CSpatial(source), m_uiGrowBy(source.m_uiGrowBy), m_bNodeFlagA(source.m_bNodeFlagA),
      m_bNodeFlagB(source.m_bNodeFlagB)
{
}

CNode::~CNode()
{
    for (const auto& child : m_kChild)
    {
        if (child)
            child->SetParent(nullptr);
    }
}

CObject* CNode::CreateClone() const
{
    return new CNode(*this);
}

CObject* CBillboardNode::CreateClone() const
{
    return new CBillboardNode(*this);
}

void CNode::Fields(CFieldArchive& archive)
{
    CSpatial::Fields(archive);
    archive.Unsigned("m_uiGrowBy", m_uiGrowBy);
    archive.Bool("m_bNodeFlagA", m_bNodeFlagA);
    archive.Bool("m_bNodeFlagB", m_bNodeFlagB);
    archive.Links("m_kChild", m_kChild);
}

void CNode::Link(COrrinStream& stream, CLinkRecord& record)
{
    CSpatial::Link(stream, record);
    for (const auto& child : m_kChild)
    {
        if (child)
            child->SetParent(this);
    }
}

void CNode::WriteHTMLFrames(const std::string& folder)
{
    CHTMLDump(folder).WriteSite(*this);
}

void CNode::DumpTable(CHTMLTables& tables)
{
    CSpatial::DumpTable(tables);
    std::string children;
    for (const auto& child : m_kChild)
    {
        if (!child)
            continue;
        children += HTMLLineBreak() + HTMLObjectAnchor(child.Get());
        tables.Follow(*child);
    }
    tables.Begin(ms_kRTTI);
    tables.Row("m_kChild", children);
}

uint64_t CNode::GetMemoryUsed() const
{
    return CSpatial::GetMemoryUsed() + 24 + 4 * m_kChild.size();
}

bool CNode::Update(float time)
{
    CSpatial::Update(time);
    for (const auto& child : m_kChild)
    {
        if (child)
            child->Update(time);
    }
    return true;
}

bool CNode::UpdateRange(uint32_t range, float time)
{
    CSpatial::UpdateRange(range, time);
    for (const auto& child : m_kChild)
    {
        if (child)
            child->UpdateRange(range, time);
    }
    return true;
}

void CNode::AppendBindOrder(std::vector<CObject*>& order)
{
    for (const auto& child : m_kChild)
        order.push_back(child.Get());
    CSpatial::AppendBindOrder(order);
}

void CNode::Render(CRenderer& renderer)
{
    for (const auto& child : m_kChild)
    {
        if (child && !child->m_bForceCull)
            child->Render(renderer);
    }
}

void CNode::UpdateTransform(float time)
{
    CSpatial::UpdateTransform(time);
    for (const auto& child : m_kChild)
    {
        if (child)
            child->UpdateTransform(time);
    }
}

void CNode::UpdateBound()
{
    bool first = true;
    for (const auto& child : m_kChild)
    {
        if (!child)
            continue;
        child->UpdateBound();
        if (first)
            m_kBound = child->m_kBound;
        else
            m_kBound.Merge(child->m_kBound);
        first = false;
    }
}

void CNode::ApplyRenderStates(RenderStateStack& stack)
{
    for (const auto& child : m_kChild)
    {
        if (child)
            child->PushAndApply(&stack);
    }
}

void CNode::CloneHeld(CCloneMap& map, CObject& copy)
{
    CSpatial::CloneHeld(map, copy);
    for (const auto& child : m_kChild)
    {
        if (child)
            static_cast<CNode&>(copy).AttachChild(static_cast<CSpatial*>(child->Clone(map)));
    }
}

CNode* CNode::CopySkeleton()
{
    CNode* copy = static_cast<CNode*>(CreateClone());
    for (const auto& child : m_kChild)
    {
        if (CNode* node = RecordCast<CNode>(child.Get()))
            copy->AttachChild(node->CopySkeleton());
    }
    return copy;
}

CNode* CNode::CopySkeleton(CCloneMap& map)
{
    const auto known = map.find(GetID());
    if (known != map.end())
        return static_cast<CNode*>(known->second);
    CNode* copy = CopySkeleton();
    map[GetID()] = copy;
    return copy;
}

Ref<CSpatial> CNode::GetChild(size_t index) const
{
    return index < m_kChild.size() ? Ref<CSpatial>(m_kChild[index].Get()) : nullptr;
}

bool CNode::AttachChild(CSpatial* child)
{
    if (!child)
        return false;
    child->SetParent(this);
    const auto slot = std::ranges::find_if(m_kChild, [](const auto& held) { return !held; });
    if (slot != m_kChild.end())
    {
        *slot = child;
        return true;
    }
    const size_t end = m_kChild.size();
    m_kChild.resize(end + 2);
    m_kChild[end] = child;
    return true;
}

bool CNode::DetachChild(CSpatial* child)
{
    if (!child)
        return false;
    for (auto& slot : m_kChild)
    {
        if (slot != child)
            continue;
        child->SetParent(nullptr);
        slot = nullptr;
    }
    return true;
}

Ref<CSpatial> CNode::SetChildAt(size_t index, CSpatial* child)
{
    Ref<CSpatial> previous = GetChild(index);
    if (index >= m_kChild.size())
        m_kChild.resize(std::clamp(m_uiGrowBy, 1u, kMostSpareSlots) + index);
    if (previous)
        previous->SetParent(nullptr);
    if (child)
        child->SetParent(this);
    m_kChild[index] = child;
    return previous;
}

bool CNode::HasNoNodeChild() const
{
    return std::ranges::none_of(m_kChild, [](const auto& child) { return RecordCast<CNode>(child.Get()); });
}

} // namespace gw
