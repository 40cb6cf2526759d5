#pragma once

#include "CTexture.h"

namespace gw {

class CImage;

/// An image on a set of texture coordinates.
class CTextureMap : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CTextureMap();
    CTextureMap(const CTextureMap& source);
    ~CTextureMap() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    int32_t m_iUVWChannel = 0; ///< which of a mesh's maps; whether the mesh has it nobody checks
    Held<CImage> m_spkImage;
};

} // namespace gw
