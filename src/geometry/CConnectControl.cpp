#include "CConnectControl.h"

#include "CConnectData.h"
#include "CFieldArchive.h"
#include "CGeometry.h"

namespace gw {

const CRTTI CConnectControl::ms_kRTTI{"CConnectControl", &CControl::ms_kRTTI};

CConnectControl::CConnectControl() = default;
CConnectControl::CConnectControl(const CConnectControl& source) = default;
CConnectControl::~CConnectControl() = default;

CObject* CConnectControl::CreateClone() const
{
    return new CConnectControl(*this);
}

void CConnectControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Link("m_spkConnectData", m_spkConnectData);
}

uint64_t CConnectControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 4;
}

bool CConnectControl::Update(float time)
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!m_bActive || !target)
        return false;
    // The two sides compare the control's own time.
    const float keyTime = MapTime(time);
    if (m_spkConnectData)
        m_spkConnectData->Reach(*target, keyTime);
    if (!target->m_bNormalsValid)
        target->UpdateWorldNormals();
    if (m_spkConnectData)
        m_spkConnectData->Update(keyTime);
    return false;
}

} // namespace gw
