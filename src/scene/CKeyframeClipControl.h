#pragma once

#include "CKeyframeControl.h"

#include <array>

namespace gw {

/// One entry of a clip schedule: which clip plays, from when, and how often.
struct ClipScheduleEntry
{
    float m_fStartTime = 0.0f; ///< in the caller's unit; mapped by frequency and phase
    int32_t m_iClip = -1;      ///< index of the clip
    int32_t m_iRepeatCount = 1;
};

/// A named range of key times.
struct ClipRecord
{
    std::array<uint8_t, 32> m_acText{};
    int32_t m_iField = -1; ///< stored only
    int32_t m_iType = 1;   ///< 0: held; 2: plays when nothing is scheduled; any other value: loops
    float m_fBegin = 0.0f; ///< key time
    float m_fEnd = 0.0f;   ///< key time
};

/// A keyframe track whose keys are divided into clips that play on a schedule. Only created by reading files.
class CKeyframeClipControl : public CKeyframeControl
{
public:
    static const CRTTI ms_kRTTI;

    CKeyframeClipControl();
    CKeyframeClipControl(const CKeyframeClipControl& source);
    ~CKeyframeClipControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool UpdateTransform(float time) override;

    /// Converts a mapped time to a key time by schedule and clips; m_fBeginTime if nothing plays.
    float ClipTime(float mapped) const;

    std::vector<ClipScheduleEntry> m_kSchedule; ///< in ascending order of start time
    std::vector<ClipRecord> m_kClips;

private:
    float IdleTime(float sinceIdle) const;
};

} // namespace gw
