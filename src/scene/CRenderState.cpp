#include "CRenderState.h"

namespace gw {

const CRTTI CRenderState::ms_kRTTI{"CRenderState", &CObject::ms_kRTTI};

RenderStateStack::RenderStateStack()
{
    for (auto& states : m_kStates)
        states.assign(1, nullptr);
}

void RenderStateStack::Push(CRenderState& state)
{
    auto& states = m_kStates[state.GetType()];
    if (states.size() < kSlots)
        states.push_back(&state);
}

void RenderStateStack::Pop(const CRenderState& state)
{
    auto& states = m_kStates[state.GetType()];
    if (states.size() > 1)
        states.pop_back();
}

CRenderState* RenderStateStack::Top(size_t type) const
{
    return m_kStates[type].back();
}

} // namespace gw
