// Converts a caller's time to a key time: frequency and phase, rounding to whole frames, then the cycle type.

#include "CControl.h"

#include "CFieldArchive.h"

#include <bit>
#include <cmath>

namespace gw {

namespace {

// From here on, every float is an integer.
constexpr float kAllWhole = 8388608.0f;

// Snaps a frame position to an integer if they differ by at most one unit in the last place. A caller reaches
// frame f at time f / frequency, and multiplying by the frequency can miss f by that much. Without this, one
// frame in twenty would be a blend of two keys.
float WholeFrame(float position)
{
    if (!(std::fabs(position) < kAllWhole))
        return position;
    const auto nearest = static_cast<float>(static_cast<int32_t>(position + std::copysign(0.5f, position)));
    // Floats with the same sign compare like their bits.
    const int32_t distance = std::bit_cast<int32_t>(position) - std::bit_cast<int32_t>(nearest);
    return distance == 1 || distance == -1 ? nearest : position;
}

} // namespace

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
    return WholeFrame(backward ? m_fEndTime - distance : distance + m_fBeginTime);
}

float CControl::MapTime(float time) const
{
    const float s = WholeFrame(time * m_fFrequency + m_fPhase);
    const float keyTime = std::isnan(s) ? s : CycledTime(s);
    return std::isnan(keyTime) ? m_fBeginTime : keyTime;
}

} // namespace gw
