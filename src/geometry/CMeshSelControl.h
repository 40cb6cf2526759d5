#pragma once

#include "CBitArray.h"
#include "CControl.h"

namespace gw {

/// A stored selection on a mesh; it changes nothing.
class CMeshSelControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CMeshSelControl(*this); }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float) override { return false; }
    bool UpdateTransform(float) override { return false; }

    CBitArray m_kSelection;
};

} // namespace gw
