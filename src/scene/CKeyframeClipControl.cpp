// Maps a time to a key time in three steps: find the scheduled clip that plays at this time, compute how far
// into the clip it is, and wrap or hold that position by the clip's type.

#include "CKeyframeClipControl.h"

#include "CFieldArchive.h"

#include <algorithm>
#include <cmath>

namespace gw {

const CRTTI CKeyframeClipControl::ms_kRTTI{"CKeyframeClipControl", &CKeyframeControl::ms_kRTTI};

namespace {

constexpr int32_t kHeldClip = 0;
constexpr int32_t kIdleClip = 2;
// One frame of tolerance, so that a clip begins on the frame that its start falls in.
constexpr float kSlack = 0.016666668f;

float ClipLocal(float u, const ClipRecord& clip)
{
    const float length = clip.m_fEnd - clip.m_fBegin;
    if (clip.m_iType == kHeldClip || !(length > 0.0f) || !std::isfinite(u))
        return clip.m_fBegin;
    // Wraps by remainder: a loop that subtracts a tiny length could run forever.
    const float local = u >= length ? std::fmod(u, length) : u;
    return local + clip.m_fBegin;
}

} // namespace

CKeyframeClipControl::CKeyframeClipControl() = default;
CKeyframeClipControl::~CKeyframeClipControl() = default;

CKeyframeClipControl::CKeyframeClipControl(const CKeyframeClipControl& source)
    : CKeyframeControl(source), m_kSchedule(source.m_kSchedule), m_kClips(source.m_kClips)
{
    m_iCycleType = static_cast<uint32_t>(ECycleType::Clamp);
}

CObject* CKeyframeClipControl::CreateClone() const
{
    return new CKeyframeClipControl(*this);
}

void CKeyframeClipControl::Fields(CFieldArchive& archive)
{
    CKeyframeControl::Fields(archive);
    archive.Array("m_kClips", m_kClips, [](CFieldArchive& fields, ClipRecord& clip) {
        fields.Row("m_acText", clip.m_acText);
        fields.Signed("m_iField", clip.m_iField);
        fields.Signed("m_iType", clip.m_iType);
        fields.Float("m_fBegin", clip.m_fBegin);
        fields.Float("m_fEnd", clip.m_fEnd);
    });
    archive.Array("m_kSchedule", m_kSchedule, [](CFieldArchive& fields, ClipScheduleEntry& entry) {
        fields.Float("m_fStartTime", entry.m_fStartTime);
        fields.Signed("m_iClip", entry.m_iClip);
        fields.Signed("m_iRepeatCount", entry.m_iRepeatCount);
    });
}

uint64_t CKeyframeClipControl::GetMemoryUsed() const
{
    return CKeyframeControl::GetMemoryUsed() + m_kClips.size() * 48 + m_kSchedule.size() * 12;
}

bool CKeyframeClipControl::UpdateTransform(float time)
{
    const float clipTime = ClipTime(time * m_fFrequency + m_fPhase);
    return CKeyframeControl::UpdateTransform((clipTime - m_fPhase) / m_fFrequency);
}

float CKeyframeClipControl::IdleTime(float sinceIdle) const
{
    const auto isIdle = [](const ClipRecord& clip) { return clip.m_iType == kIdleClip; };
    const auto idle = std::ranges::find_if(m_kClips, isIdle);
    return idle == m_kClips.end() ? m_fBeginTime : ClipLocal(sinceIdle, *idle);
}

float CKeyframeClipControl::ClipTime(float mapped) const
{
    const auto scaled = [this](const ClipScheduleEntry& entry) {
        return entry.m_fStartTime * m_fFrequency + m_fPhase;
    };
    const auto begun = [&](const ClipScheduleEntry& entry) { return !(scaled(entry) >= mapped + kSlack); };
    const auto next = std::ranges::find_if_not(m_kSchedule, begun);
    if (next == m_kSchedule.begin())
        return IdleTime(mapped - m_fPhase);

    const ClipScheduleEntry& current = *(next - 1);
    if (current.m_iClip < 0 || static_cast<size_t>(current.m_iClip) >= m_kClips.size())
        return m_fBeginTime;
    const ClipRecord& clip = m_kClips[static_cast<size_t>(current.m_iClip)];
    const float length = clip.m_fEnd - clip.m_fBegin;
    if (length == 0.0f)
        return clip.m_fBegin;
    const float u = mapped - scaled(current);
    const float played = static_cast<float>(current.m_iRepeatCount) * length;
    return played < u + kSlack ? IdleTime(u - played) : ClipLocal(u, clip);
}

} // namespace gw
