#pragma once

#include "CObject.h"

#include <array>
#include <vector>

namespace gw {

/// The number of render state types, and of the slots that a geometry has for them.
inline constexpr size_t kRenderStateTypes = 7;

/// One kind of drawing state. No concrete class derives from it; lists and slots of it exist for files and
/// callers.
class CRenderState : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    /// 0 to 6: which of the slots this state belongs in.
    virtual size_t GetType() const = 0;
};

/// The states in force at one place of the render state walk, a stack for each type. Entry 0 is the type's
/// default.
class RenderStateStack
{
public:
    RenderStateStack();

    /// A full stack (127 states above the default) drops the push.
    void Push(CRenderState& state);
    /// A stack with nothing above its default stays as it is.
    void Pop(const CRenderState& state);
    /// The state in force, or null for an empty default.
    CRenderState* Top(size_t type) const;

private:
    static constexpr size_t kSlots = 128;

    std::array<std::vector<CRenderState*>, kRenderStateTypes> m_kStates;
};

} // namespace gw
