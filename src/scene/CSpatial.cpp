// Scene updates run in three passes over a subtree: world matrices top down, then the controls that are not
// transforms, then bounds bottom up. Render states are found by walking up the parent chain.

#include "CSpatial.h"

#include "CControl.h"
#include "CCustomData.h"
#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "HTMLMarkup.h"
#include "HTMLText.h"

#include <utility>

namespace gw {

const CRTTI CSpatial::ms_kRTTI{"CSpatial", &CObject::ms_kRTTI};

CSpatial::CSpatial() = default;
CSpatial::~CSpatial() = default;

// Parent and render states are not copied: a copy has no parent, and cloning attaches the copied states.
CSpatial::CSpatial(const CSpatial& source)
    : CObject(source), m_kMatrix(source.m_kMatrix), m_kWorldMatrix(source.m_kWorldMatrix),
      m_kBound(source.m_kBound), m_bStoredFlag(source.m_bStoredFlag), m_bForceCull(source.m_bForceCull)
{
}

void CSpatial::CloneHeld(CCloneMap& map, CObject& copy)
{
    CSpatial& spatial = static_cast<CSpatial&>(copy);
    spatial.m_pkRenderStates.resize(m_pkRenderStates.size()); // later links are matched by position
    CObject::CloneHeld(map, copy);
    // Attaching prepends each state, so the copy's list is in reverse order.
    for (const auto& state : std::exchange(spatial.m_pkRenderStates, {}))
    {
        if (state)
            spatial.AttachRenderState(*state);
    }
}

void CSpatial::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Matrix("m_kMatrix", m_kMatrix);
    archive.Bool("m_bStoredFlag", m_bStoredFlag);
    archive.Links("m_pkRenderStates", m_pkRenderStates);
}

void CSpatial::DumpTable(CHTMLTables& tables)
{
    CObject::DumpTable(tables);
    tables.Begin(ms_kRTTI);
    tables.Row("Parent", HTMLObjectAnchor(m_pkParent));
    tables.Row("m_kMatrix", HTMLText(m_kMatrix));
    tables.Row("m_kWorldMatrix", HTMLText(m_kWorldMatrix));
    tables.Row("m_bForceCull", HTMLText(m_bForceCull));
}

uint64_t CSpatial::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 156 + 8 * m_pkRenderStates.size();
}

bool CSpatial::Update(float time)
{
    CObject::Update(time);
    for (const auto& state : m_pkRenderStates)
    {
        if (state)
            state->Update(time);
    }
    return true;
}

bool CSpatial::UpdateRange(uint32_t range, float time)
{
    CObject::UpdateRange(range, time);
    for (const auto& state : m_pkRenderStates)
    {
        if (state)
            state->UpdateRange(range, time);
    }
    return true;
}

void CSpatial::AppendBindOrder(std::vector<CObject*>& order)
{
    for (const auto& state : m_pkRenderStates)
        order.push_back(state.Get());
    order.insert(order.end(), {GetControl(), GetModifier(), GetCustomData()});
}

void CSpatial::UpdateTransform(float time)
{
    int rewritten = 0;
    for (CControl* control = GetControl(); control; control = control->GetNext())
        rewritten += control->UpdateTransform(time) ? 1 : 0;
    if (rewritten <= 1)
        UpdateWorldMatrix();
    for (CModifier* modifier = RecordCast<CModifier>(GetModifier()); modifier;
         modifier = RecordCast<CModifier>(modifier->GetNext()))
        modifier->UpdateTransform(time);
    for (const auto& state : m_pkRenderStates)
    {
        for (CControl* control = state ? state->GetControl() : nullptr; control; control = control->GetNext())
            control->UpdateTransform(time);
    }
}

void CSpatial::UpdateWorldMatrix()
{
    m_kWorldMatrix = m_pkParent ? m_kMatrix * m_pkParent->m_kWorldMatrix : m_kMatrix;
}

void CSpatial::UpdateScene(float time, bool upward)
{
    UpdateTransform(time);
    Update(time);
    UpdateBound();
    for (CSpatial* ancestor = upward ? m_pkParent : nullptr; ancestor; ancestor = ancestor->m_pkParent)
        ancestor->UpdateBound();
}

void CSpatial::PushAndApply(RenderStateStack* stack)
{
    if (!stack)
    {
        RenderStateStack fresh;
        PushChain(fresh);
        ApplyRenderStates(fresh);
        PopChain(fresh);
        return;
    }
    for (const auto& state : m_pkRenderStates)
    {
        if (state)
            stack->Push(*state);
    }
    ApplyRenderStates(*stack);
    for (const auto& state : m_pkRenderStates)
    {
        if (state)
            stack->Pop(*state);
    }
}

void CSpatial::PushChain(RenderStateStack& stack)
{
    if (m_pkParent)
        m_pkParent->PushChain(stack);
    for (const auto& state : m_pkRenderStates)
    {
        if (state)
            stack.Push(*state);
    }
}

void CSpatial::PopChain(RenderStateStack& stack)
{
    for (CSpatial* spatial = this; spatial; spatial = spatial->m_pkParent)
    {
        for (const auto& state : spatial->m_pkRenderStates)
        {
            if (state)
                stack.Pop(*state);
        }
    }
}

Ref<CRenderState> CSpatial::AttachRenderState(CRenderState& state)
{
    for (auto& slot : m_pkRenderStates)
    {
        if (!slot || slot->GetType() != state.GetType())
            continue;
        Ref<CRenderState> replaced = slot.Get();
        slot = &state;
        return replaced;
    }
    m_pkRenderStates.emplace(m_pkRenderStates.begin(), &state);
    return nullptr;
}

} // namespace gw
