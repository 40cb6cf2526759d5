#include "CTextureMap.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "CImage.h"

namespace gw {

const CRTTI CTextureMap::ms_kRTTI{"CTextureMap", &CTexture::ms_kRTTI};

CTextureMap::CTextureMap() = default;
CTextureMap::CTextureMap(const CTextureMap& source) = default;
CTextureMap::~CTextureMap() = default;

CObject* CTextureMap::CreateClone() const
{
    return new CTextureMap(*this);
}

void CTextureMap::Fields(CFieldArchive& archive)
{
    CTexture::Fields(archive);
    archive.Signed("m_iUVWChannel", m_iUVWChannel);
    archive.Link("m_spkImage", m_spkImage);
}

void CTextureMap::DumpTable(CHTMLTables& tables)
{
    CTexture::DumpTable(tables);
    tables.OwnFields<CTextureMap, CTexture>(*this);
}

uint64_t CTextureMap::GetMemoryUsed() const
{
    return CTexture::GetMemoryUsed() + 8;
}

} // namespace gw
