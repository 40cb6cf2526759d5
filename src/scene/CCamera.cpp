#include "CCamera.h"

#include "CFieldArchive.h"

namespace gw {

const CRTTI CCameraTarget::ms_kRTTI{"CCameraTarget", &CSpatial::ms_kRTTI};
const CRTTI CCamera::ms_kRTTI{"CCamera", &CSpatial::ms_kRTTI};

CCamera::CCamera() = default;
CCamera::CCamera(const CCamera& source) = default;
CCamera::~CCamera() = default;

CObject* CCamera::CreateClone() const
{
    return new CCamera(*this);
}

void CCamera::Fields(CFieldArchive& archive)
{
    CSpatial::Fields(archive);
    archive.Row("m_afParameter", m_afParameter);
    archive.Vector("m_kEye", m_kEye);
    archive.Vector("m_kUp", m_kUp);
    archive.Vector("m_kLookAt", m_kLookAt);
    archive.Bool("m_bCameraFlagA", m_bCameraFlagA);
    archive.Bool("m_bCameraFlagB", m_bCameraFlagB);
    archive.Link("m_spkCameraTarget", m_spkCameraTarget);
}

uint64_t CCamera::GetMemoryUsed() const
{
    return CSpatial::GetMemoryUsed() + 96;
}

bool CCamera::Update(float time)
{
    CSpatial::Update(time);
    m_kWorldEye = TransformCoord(m_kEye, m_kWorldMatrix);
    return true;
}

bool CCamera::Bind(CObject& root)
{
    if (m_spkCameraTarget)
        m_spkCameraTarget->Bind(root);
    return CSpatial::Bind(root);
}

bool CCamera::Rebind(const CCloneMap& map)
{
    if (m_spkCameraTarget)
        m_spkCameraTarget->Rebind(map);
    return CSpatial::Rebind(map);
}

} // namespace gw
