#include "CMultiMaterial.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"

namespace gw {

const CRTTI CMultiMaterial::ms_kRTTI{"CMultiMaterial", &CMaterial::ms_kRTTI};

CMultiMaterial::CMultiMaterial() = default;
CMultiMaterial::CMultiMaterial(const CMultiMaterial& source) = default;
CMultiMaterial::~CMultiMaterial() = default;

CObject* CMultiMaterial::CreateClone() const
{
    return new CMultiMaterial(*this);
}

void CMultiMaterial::Fields(CFieldArchive& archive)
{
    CMaterial::Fields(archive);
    archive.Links("m_kSubMaterials", m_kSubMaterials);
}

void CMultiMaterial::DumpTable(CHTMLTables& tables)
{
    CMaterial::DumpTable(tables);
    tables.OwnFields<CMultiMaterial, CMaterial>(*this);
}

uint64_t CMultiMaterial::GetMemoryUsed() const
{
    return CMaterial::GetMemoryUsed() + 4 + 4 * m_kSubMaterials.size();
}

void CMultiMaterial::SetSubMaterialCount(size_t count)
{
    m_kSubMaterials.clear();
    m_kSubMaterials.resize(count);
}

} // namespace gw
