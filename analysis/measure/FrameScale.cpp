#include "FrameScale.h"

#include <algorithm>
#include <cstdint>
#include <numeric>

namespace gw {

namespace {

constexpr int kScaleRate = 120;    // a result is saved with this by its profile's rate as frame scale
constexpr int kHighestRate = 1200; // of a profile, faster than any recording
// The rates in use share many factors with this: 24, 25, 30, 50, 60, 100, 120, 150, 240 divide it.
constexpr int kRoundRate = 1200;

// The frames of a result saved by a profile's rate, cut in 32 bits as the writer does.
int64_t SavedFrames(int sourceFrames, int rate)
{
    const float scale = static_cast<float>(kScaleRate) / static_cast<float>(rate);
    return static_cast<int64_t>(static_cast<float>(sourceFrames) * scale);
}

} // namespace

double FrameScaleOf(int sourceFrames, int resultFrames)
{
    if (sourceFrames <= 0 || resultFrames <= 0)
        return 1.0;
    int roundest = 0;
    auto rate =
        static_cast<int>(std::min<int64_t>(int64_t{kScaleRate} * sourceFrames / resultFrames, kHighestRate));
    for (; rate > 0 && SavedFrames(sourceFrames, rate) == resultFrames; --rate)
    {
        if (std::gcd(rate, kRoundRate) > std::gcd(roundest, kRoundRate) || roundest == 0)
            roundest = rate;
    }
    return roundest > 0 ? static_cast<double>(kScaleRate) / roundest
                        : static_cast<double>(resultFrames) / sourceFrames;
}

int ComparedFrames(int sourceFrames, int resultFrames, double frameScale)
{
    constexpr double kRounding = 1e-6;
    return std::min(sourceFrames, static_cast<int>((resultFrames - 1) / frameScale + kRounding) + 1);
}

} // namespace gw
