#include "CControl.h"

#include "CFieldArchive.h"

#include <cmath>

namespace gw {

const CRTTI CControl::ms_kRTTI{"CControl", &CObject::ms_kRTTI};
const CRTTI CModifier::ms_kRTTI{"CModifier", &CControl::ms_kRTTI};

CControl::CControl() = default;
CControl::CControl(const CControl& source) = default;
CControl::~CControl() = default;

void CControl::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Unsigned("m_iCycleType", m_iCycleType);
    archive.Float("m_fBeginTime", m_fBeginTime);
    archive.Float("m_fEndTime", m_fEndTime);
    archive.Float("m_fPhase", m_fPhase);
    archive.Float("m_fFrequency", m_fFrequency);
    archive.Bool("m_bActive", m_bActive);
    archive.PlainLink("m_pkTarget", m_pkTarget);
    archive.Link("m_spkNext", m_spkNext);
}

uint64_t CControl::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 32;
}

// The copy has no target until it is attached.
void CControl::CloneHeld(CCloneMap& map, CObject& copy)
{
    CObject::CloneHeld(map, copy);
    static_cast<CControl&>(copy).SetTarget(nullptr);
}

bool CControl::UpdateRange(uint32_t, float time)
{
    return Update(time);
}

CControl* CControl::GetLast()
{
    CControl* last = this;
    while (last->GetNext())
        last = last->GetNext();
    return last;
}

float CControl::CycledTime(float s) const
{
    if (m_iCycleType == static_cast<uint32_t>(ECycleType::Clamp))
    {
        if (s < m_fBeginTime)
            return m_fBeginTime;
        return s <= m_fEndTime ? s : m_fEndTime;
    }
    const float range = m_fEndTime - m_fBeginTime;
    if (range <= 0.0f || !std::isfinite(s) || !std::isfinite(range))
        return m_fBeginTime;
    const float x = (s - m_fBeginTime) / range;
    const float period = std::floor(x);
    const float distance = (x - period) * range;
    const bool backward =
        m_iCycleType != static_cast<uint32_t>(ECycleType::Loop) && std::fmod(period, 2.0f) != 0.0f;
    return backward ? m_fEndTime - distance : distance + m_fBeginTime;
}

float CControl::MapTime(float time) const
{
    const float s = time * m_fFrequency + m_fPhase;
    const float keyTime = std::isnan(s) ? s : CycledTime(s);
    return std::isnan(keyTime) ? m_fBeginTime : keyTime;
}

} // namespace gw
