#pragma once

#include "CVectorKeyControl.h"

namespace gw {

/// Writes the colour of its target, a light.
class CLightControl : public CVectorKeyControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CLightControl(*this); }
    /// Without keys the colour stays. Always false.
    bool Update(float time) override;
};

} // namespace gw
