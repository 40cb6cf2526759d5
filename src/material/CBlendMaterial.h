#pragma once

#include "CMaterialBase.h"

#include <array>

namespace gw {

/// Two materials blended by a mask.
class CBlendMaterial : public CMaterial
{
public:
    static const CRTTI ms_kRTTI;

    CBlendMaterial();
    CBlendMaterial(const CBlendMaterial& source);
    ~CBlendMaterial() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    float m_fBlend = 0.0f;
    Held<CMaterialBase> m_spkMask;
    std::array<Held<CMaterialBase>, 2> m_aspkMtl; ///< may be equal or null
};

} // namespace gw
