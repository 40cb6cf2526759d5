#include "CEditNormalControl.h"

#include "CEditNormalData.h"
#include "CFieldArchive.h"
#include "CGeometry.h"

namespace gw {

const CRTTI CEditNormalControl::ms_kRTTI{"CEditNormalControl", &CControl::ms_kRTTI};

CEditNormalControl::CEditNormalControl() = default;
CEditNormalControl::CEditNormalControl(const CEditNormalControl& source) = default;
CEditNormalControl::~CEditNormalControl() = default;

CObject* CEditNormalControl::CreateClone() const
{
    return new CEditNormalControl(*this);
}

void CEditNormalControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Link("m_spkEditNormalData", m_spkEditNormalData);
}

uint64_t CEditNormalControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 4;
}

bool CEditNormalControl::Update(float time)
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!m_bActive || !target)
        return false;
    if (!target->m_bNormalsValid)
        target->UpdateWorldNormals();
    if (m_spkEditNormalData)
        m_spkEditNormalData->Update(MapTime(time));
    return false;
}

} // namespace gw
