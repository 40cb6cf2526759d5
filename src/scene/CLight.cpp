#include "CLight.h"

#include "CFieldArchive.h"

namespace gw {

const CRTTI CLight::ms_kRTTI{"CLight", &CSpatial::ms_kRTTI};
const CRTTI CPointLight::ms_kRTTI{"CPointLight", &CLight::ms_kRTTI};

void CLight::Fields(CFieldArchive& archive)
{
    CSpatial::Fields(archive);
    archive.Vector("m_kRGB", m_kRGB);
    archive.Float("m_fIntensity", m_fIntensity);
    archive.Bool("m_bLightOn", m_bLightOn);
}

uint64_t CLight::GetMemoryUsed() const
{
    return CSpatial::GetMemoryUsed() + 20;
}

void CPointLight::Fields(CFieldArchive& archive)
{
    CLight::Fields(archive);
    archive.Vector("m_kLocation", m_kLocation);
}

uint64_t CPointLight::GetMemoryUsed() const
{
    return CLight::GetMemoryUsed() + 28;
}

bool CPointLight::Update(float time)
{
    CLight::Update(time);
    m_kWorldLocation = TransformCoord(m_kLocation, m_kWorldMatrix);
    return true;
}

} // namespace gw
