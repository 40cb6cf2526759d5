#include "CLight.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"
#include "HTMLText.h"

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

void CLight::DumpTable(CHTMLTables& tables)
{
    CSpatial::DumpTable(tables);
    tables.Begin(ms_kRTTI);
    tables.Row("m_kRGB", HTMLText(m_kRGB));
    tables.Row("m_fIntensity", HTMLText(m_fIntensity));
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

void CPointLight::DumpTable(CHTMLTables& tables)
{
    CLight::DumpTable(tables);
    tables.Begin(ms_kRTTI);
    tables.Row("m_kLocation", HTMLText(m_kLocation));
    tables.Row("m_kWorldLocation", HTMLText(m_kWorldLocation));
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
