#include "LegJitter.h"

#include "CBodyTrack.h"
#include "Figures.h"

#include <algorithm>

namespace gw {

namespace {

constexpr double kJitterSeconds = 1.0 / 30.0;
// A direction at rest has about this jitter from rounding alone: unit directions are accurate to 1e-7.
constexpr double kStillJitter = 1e-6;

} // namespace

double JitterOf(const std::vector<Vec3>& from, const std::vector<Vec3>& to, double secondsPerFrame)
{
    const double framesPerStep = std::max(kJitterSeconds / secondsPerFrame, 1.0);
    const auto direction = [&](size_t f) { return Vec3Normalized(to[f] - from[f]); };
    CRunningMean bends;
    Vec3 last = kVec3Zero;
    Vec3 beforeLast = kVec3Zero;
    for (size_t step = 0;; ++step)
    {
        const double frame = static_cast<double>(step) * framesPerStep;
        if (!(frame <= static_cast<double>(from.size()) - 1.0))
            return bends.Mean();
        const auto before = static_cast<size_t>(frame);
        const auto share = static_cast<float>(frame - static_cast<double>(before));
        Vec3 present = direction(before);
        if (share > 0.0f)
            present = Vec3Normalized(present * (1.0f - share) + direction(before + 1) * share);
        if (step >= 2)
            bends.Add(Vec3Length(beforeLast - last * 2.0f + present));
        beforeLast = last;
        last = present;
    }
}

std::vector<float> LegJitterRatios(const CBodyTrack& source, const CBodyTrack& result, double secondsPerFrame)
{
    std::vector<float> ratios;
    const auto add = [&](const CBodyTrack::Leg& from, const CBodyTrack::Leg& to, auto start, auto end) {
        const double sourceJitter = JitterOf(from.*start, from.*end, secondsPerFrame);
        const double resultJitter = JitterOf(to.*start, to.*end, secondsPerFrame);
        if (const auto ratio = RatioOf(resultJitter, sourceJitter, kStillJitter))
            ratios.push_back(static_cast<float>(*ratio));
    };
    for (size_t leg = 0; leg < source.Legs().size(); ++leg)
    {
        add(source.Legs()[leg], result.Legs()[leg], &CBodyTrack::Leg::hip, &CBodyTrack::Leg::knee);
        add(source.Legs()[leg], result.Legs()[leg], &CBodyTrack::Leg::knee, &CBodyTrack::Leg::ankle);
    }
    return ratios;
}

} // namespace gw
