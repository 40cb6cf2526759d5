#include "CCamera.h"

#include "CFieldArchive.h"

namespace gw {

const CRTTI CCameraTarget::ms_kRTTI{"CCameraTarget", &CSpatial::ms_kRTTI};
const CRTTI CCamera::ms_kRTTI{"CCamera", &CSpatial::ms_kRTTI};

CCamera::CCamera() = default;
CCamera::~CCamera() = default;

// A plain copy keeps the same look-at target; cloning replaces it by the target's copy.
CCamera::CCamera(const CCamera& source)
    : CSpatial(source), m_afParameter(source.m_afParameter), m_kEye(source.m_kEye), m_kUp(source.m_kUp),
      m_kWorldEye(source.m_kWorldEye), m_kControlVector(source.m_kControlVector),
      m_bCameraFlagA(source.m_bCameraFlagA), m_bCameraFlagB(source.m_bCameraFlagB),
      m_kLookAt(source.m_kLookAt)
{
    m_spkCameraTarget = source.m_spkCameraTarget.Get();
}

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

void CCamera::AppendBindOrder(std::vector<CObject*>& order)
{
    order.push_back(m_spkCameraTarget.Get());
    CSpatial::AppendBindOrder(order);
}

} // namespace gw
