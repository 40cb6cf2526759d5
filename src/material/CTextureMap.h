#pragma once

#include "CTexture.h"

namespace gw {

class CImage;

/// An image applied to a set of texture coordinates.
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

    int32_t m_iUVWChannel = 0; ///< index of a mesh's map; not checked against the mesh
    Held<CImage> m_spkImage;
};

} // namespace gw
