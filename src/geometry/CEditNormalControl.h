#pragma once

#include "CControl.h"

namespace gw {

class CEditNormalData;

/// Triggers smoothing of normals across meshes once its target, one of them, is up to date.
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
    /// Updates the target's normals and smooths if possible. Always returns false.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    Held<CEditNormalData> m_spkEditNormalData; ///< shared by the controls of all its meshes
};

} // namespace gw
