#include "MeasureResult.h"

#include "CFileConversion.h"
#include "CKeyframeControl.h"
#include "SourceTiming.h"

namespace gw {

MotionClip SourceClipOf(const CFileConversion& conversion)
{
    const CKeyframeControl* track = ConversionTrack(conversion.SourceRoot());
    if (!track)
        return {};
    return {conversion.DrivingRoot(), track->m_fFrequency, static_cast<int>(track->m_kKeyTimes.size())};
}

std::optional<MeasuredConversion> MeasureResult(const MotionClip& source, const MotionClip& result,
                                                std::span<const BonePair> pairs)
{
    MeasuredConversion measured;
    measured.sums = MeasureConversion(source, result, pairs, &measured.detail);
    return measured.sums.frameCount > 0 ? std::optional(std::move(measured)) : std::nullopt;
}

} // namespace gw
