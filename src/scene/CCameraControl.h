#pragma once

#include "CVectorKeyControl.h"

namespace gw {

/// Animates the control vector of its target, a camera.
class CCameraControl : public CVectorKeyControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CCameraControl(*this); }
    /// Without keys, the vector becomes (0, 0, 1). Always returns false.
    bool Update(float time) override;
};

} // namespace gw
