#include "FrameScale.h"

#include <algorithm>
#include <cstdint>
#include <numeric>

namespace gw {

namespace {

constexpr int kScaleRate = 120;    // a saved result's frame scale is this divided by its profile's rate
constexpr int kHighestRate = 1200; // of a profile, faster than any recording
// The usual rates (24, 25, 30, 50, 60, 100, 120, 150, 240) divide this number.
constexpr int kRoundRate = 1200;

// Returns the number of frames of a result saved with a profile's rate, truncated in 32 bits like the writer.
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
