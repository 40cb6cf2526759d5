#include "CNormalBumpTex.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"

namespace gw {

const CRTTI CNormalBumpTex::ms_kRTTI{"CNormalBumpTex", &CTexture::ms_kRTTI};

CNormalBumpTex::CNormalBumpTex() = default;
CNormalBumpTex::CNormalBumpTex(const CNormalBumpTex& source) = default;
CNormalBumpTex::~CNormalBumpTex() = default;

CObject* CNormalBumpTex::CreateClone() const
{
    return new CNormalBumpTex(*this);
}

void CNormalBumpTex::Fields(CFieldArchive& archive)
{
    CTexture::Fields(archive);
    archive.Bool("m_bUseFirstMap", m_bUseFirstMap);
    archive.Bool("m_bUseSecondMap", m_bUseSecondMap);
    archive.Float("m_fFirstAmount", m_fFirstAmount);
    archive.Float("m_fSecondAmount", m_fSecondAmount);
    archive.Link("m_spkFirstMap", m_spkFirstMap);
    archive.Link("m_spkSecondMap", m_spkSecondMap);
}

void CNormalBumpTex::DumpTable(CHTMLTables& tables)
{
    CTexture::DumpTable(tables);
    tables.OwnFields<CNormalBumpTex, CTexture>(*this);
}

uint64_t CNormalBumpTex::GetMemoryUsed() const
{
    return CTexture::GetMemoryUsed() + 20;
}

} // namespace gw
