#pragma once

#include "CVectorKeyControl.h"

namespace gw {

/// Animates the color of its target, a light.
class CLightControl : public CVectorKeyControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CLightControl(*this); }
    /// Without keys, the color is unchanged. Always returns false.
    bool Update(float time) override;
};

} // namespace gw
