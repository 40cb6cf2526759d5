// Heights are found by least squares over all frames: the sole on the floor once it has landed, elsewhere
// close to its free path, without sudden changes. A little is left of the free height of a sole that has
// landed, so that steps on a floor that is not quite level do not shake the leg. But a sole that would
// visibly hover or sink is weighted more in a second round, which corrects it. A sole that hovers for a frame
// or two is a glitch of the recording, and must not drag the whole stance below the floor. A foot that is
// still in the air, or on a step, is kept from coming so low that it seems to stand.

#include "LandFoot.h"

#include "CBandFit.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kFullDip = 20.0;     // millimeters below the floor at which kDipWeight applies in full
constexpr double kLandedWeight = 8.0; // weight of a sole that stands; the free path has weight 1
constexpr double kDipWeight = 15.0;   // weight of a sole below the floor
constexpr double kAloftWeight = 8.0;  // weight of a foot that is still but does not stand
constexpr double kLandHertz = 1.4;    // of the changes between the two
constexpr double kHover = 12.0;       // millimeters from the floor at which a landed sole is weighted double
constexpr double kSunk = 6.0;         // millimeters below the floor at which a dip is weighted double
constexpr double kMostSunk = 3.0;     // what sinking adds to the weight of a dip, at most
constexpr double kGlitchSeconds = 1.0 / 30.0;
constexpr int kLandRounds = 2;

double FourthPower(double x)
{
    return x * x * (x * x);
}

// Returns the median of the values at a frame, before it and after it.
double SteadyAt(const std::vector<double>& values, size_t frame, size_t apart)
{
    const double before = values[frame - std::min(frame, apart)];
    const double after = values[std::min(frame + apart, values.size() - 1)];
    return std::max(std::min(before, after), std::min(std::max(before, after), values[frame]));
}

} // namespace

std::vector<double> LandFoot(std::span<const SoleWish> wishes, double secondsPerFrame)
{
    std::vector<double> heights(wishes.size(), 0.0);
    const auto apart = static_cast<size_t>(std::clamp(kGlitchSeconds / secondsPerFrame, 1.0, 1000.0));
    for (int round = 0; round < kLandRounds; ++round)
    {
        CBandFit rise(wishes.size(), BendWeight(kLandHertz, secondsPerFrame), 1.0);
        for (size_t frame = 0; frame < wishes.size(); ++frame)
        {
            const SoleWish& wish = wishes[frame];
            const auto sole = static_cast<double>(wish.free);
            const auto share = static_cast<double>(wish.landed);
            const double hovers = FourthPower(share * SteadyAt(heights, frame, apart) / kHover);
            rise.AddValue(frame, share > 0.0 ? kLandedWeight * (1.0 + hovers) : 0.0, -share * sole);
            rise.AddValue(frame, kAloftWeight * static_cast<double>(wish.aloft),
                          static_cast<double>(std::max(wish.least - wish.free, 0.0f)));
            const double sinks = std::min(FourthPower(std::min(heights[frame], 0.0) / kSunk), kMostSunk);
            rise.AddValue(frame, kDipWeight * (1.0 + sinks) * Smoothstep(-sole / kFullDip), -sole);
        }
        heights = rise.Solve();
        for (size_t frame = 0; frame < heights.size(); ++frame)
            heights[frame] += static_cast<double>(wishes[frame].free);
    }
    return heights;
}

} // namespace gw
