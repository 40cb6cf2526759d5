#include "CBlendMaterial.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"

namespace gw {

const CRTTI CBlendMaterial::ms_kRTTI{"CBlendMaterial", &CMaterial::ms_kRTTI};

CBlendMaterial::CBlendMaterial() = default;
CBlendMaterial::CBlendMaterial(const CBlendMaterial& source) = default;
CBlendMaterial::~CBlendMaterial() = default;

CObject* CBlendMaterial::CreateClone() const
{
    return new CBlendMaterial(*this);
}

void CBlendMaterial::Fields(CFieldArchive& archive)
{
    CMaterial::Fields(archive);
    archive.Float("m_fBlend", m_fBlend);
    archive.Link("m_spkMask", m_spkMask);
    archive.LinkRow("m_aspkMtl", m_aspkMtl);
}

void CBlendMaterial::DumpTable(CHTMLTables& tables)
{
    CMaterial::DumpTable(tables);
    tables.OwnFields<CBlendMaterial, CMaterial>(*this);
}

uint64_t CBlendMaterial::GetMemoryUsed() const
{
    return CMaterial::GetMemoryUsed() + 16;
}

} // namespace gw
