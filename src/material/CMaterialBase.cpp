#include "CMaterialBase.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"

namespace gw {

const CRTTI CMaterialBase::ms_kRTTI{"CMaterialBase", &CObject::ms_kRTTI};
const CRTTI CMaterial::ms_kRTTI{"CMaterial", &CMaterialBase::ms_kRTTI};

void CMaterialBase::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Bool("m_bTwoSided", m_bTwoSided);
}

void CMaterialBase::DumpTable(CHTMLTables& tables)
{
    CObject::DumpTable(tables);
    tables.OwnFields<CMaterialBase, CObject>(*this);
}

uint64_t CMaterialBase::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 4;
}

} // namespace gw
