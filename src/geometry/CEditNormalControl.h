#pragma once

#include "CControl.h"

namespace gw {

class CEditNormalData;

/// Lets normals be smoothed across meshes once its target, one of them, is up to date.
class CEditNormalControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    CEditNormalControl();
    CEditNormalControl(const CEditNormalControl& source);
    ~CEditNormalControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Makes the target's normals current and lets the smoothing run if it can. Always false.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    Held<CEditNormalData> m_spkEditNormalData; ///< shared by the controls on all its meshes
};

} // namespace gw
