#include "CSprite.h"

#include "CFieldArchive.h"
#include "CImage.h"

namespace gw {

const CRTTI CSprite::ms_kRTTI{"CSprite", &CObject::ms_kRTTI};

CSprite::CSprite() = default;
CSprite::CSprite(const CSprite& source) = default;
CSprite::~CSprite() = default;

CObject* CSprite::CreateClone() const
{
    return new CSprite(*this);
}

void CSprite::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Link("m_spkImage", m_spkImage);
    archive.Signed("value A", m_iValueA);
    archive.Signed("value B", m_iValueB);
    archive.Bool("flag", m_bFlag);
    archive.Signed("value C", m_iValueC);
}

uint64_t CSprite::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 20;
}

} // namespace gw
