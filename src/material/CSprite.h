#pragma once

#include "CObject.h"

namespace gw {

class CImage;

/// An image with three values and a flag, preserved in files and copies but not used.
class CSprite : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CSprite();
    CSprite(const CSprite& source);
    ~CSprite() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;

    Held<CImage> m_spkImage;
    int32_t m_iValueA = 1;
    int32_t m_iValueB = 0;
    bool m_bFlag = false;
    int32_t m_iValueC = 0;
};

} // namespace gw
