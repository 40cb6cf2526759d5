#pragma once

#include "CObject.h"

#include <array>
#include <vector>

namespace gw {

/// The number of render state types, and of a geometry's slots for them.
inline constexpr size_t kRenderStateTypes = 7;

/// A drawing state. It has no concrete classes; its lists and slots exist for files and callers.
class CRenderState : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    /// Returns the slot that this state belongs in, 0 to 6.
    virtual size_t GetType() const = 0;
};

/// The render states in effect during the render walk: one stack per type. Entry 0 is the type's default.
class RenderStateStack
{
public:
    RenderStateStack();

    /// Pushes a state; ignored if the stack is full (127 states above the default).
    void Push(CRenderState& state);
    /// Pops a state; ignored if only the default is left.
    void Pop(const CRenderState& state);
    /// Returns the state in effect, or null if the default is empty.
    CRenderState* Top(size_t type) const;

private:
    static constexpr size_t kSlots = 128;

    std::array<std::vector<CRenderState*>, kRenderStateTypes> m_kStates;
};

} // namespace gw
