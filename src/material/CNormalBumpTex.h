#pragma once

#include "CTexture.h"

namespace gw {

/// Two textures that perturb normals together.
class CNormalBumpTex : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CNormalBumpTex();
    CNormalBumpTex(const CNormalBumpTex& source);
    ~CNormalBumpTex() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    bool m_bUseFirstMap = true;
    bool m_bUseSecondMap = true;
    float m_fFirstAmount = 1.0f;
    float m_fSecondAmount = 1.0f;
    Held<CTexture> m_spkFirstMap;
    Held<CTexture> m_spkSecondMap;
};

} // namespace gw
