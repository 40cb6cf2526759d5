#pragma once

#include "CControl.h"

namespace gw {

class CConnectData;

/// Notifies a seam that its target, one of the two meshes, has reached a time.
class CConnectControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    CConnectControl();
    CConnectControl(const CConnectControl& source);
    ~CConnectControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Updates the target's normals and closes the seam if possible. Always returns false.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    Held<CConnectData> m_spkConnectData; ///< shared with the control on the other mesh
};

} // namespace gw
