#include "CMeshSelControl.h"

#include "CFieldArchive.h"

namespace gw {

const CRTTI CMeshSelControl::ms_kRTTI{"CMeshSelControl", &CControl::ms_kRTTI};

void CMeshSelControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    m_kSelection.Fields(archive, "m_kSelection");
}

uint64_t CMeshSelControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + m_kSelection.MemoryUsed();
}

} // namespace gw
