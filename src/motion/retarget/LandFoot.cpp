// Heights are found by least squares over all frames: the sole on the floor once it has landed, elsewhere
// close to its free path, without sudden changes. A little is left of the free height of a sole that has
// landed, so that steps on a floor that is not quite level do not shake the leg. But a sole that would
// visibly hover is weighted more in a second round, which takes it down.

#include "LandFoot.h"

#include "CBandFit.h"
#include "Figures.h"

#include <cmath>

namespace gw {

namespace {

constexpr double kFullDip = 20.0;     // millimeters below the floor at which kDipWeight applies in full
constexpr double kLandedWeight = 6.0; // weight of a sole that stands; the free path has weight 1
constexpr double kDipWeight = 15.0;   // weight of a sole below the floor
constexpr double kLandHertz = 1.4;    // of the changes between the two
constexpr double kHover = 12.0;       // millimeters from the floor at which a landed sole is weighted double
constexpr int kRounds = 2;

} // namespace

std::vector<double> LandFoot(std::span<const float> free, std::span<const float> landed,
                             double secondsPerFrame)
{
    std::vector<double> heights(free.size(), 0.0);
    for (int round = 0; round < kRounds; ++round)
    {
        CBandFit rise(free.size(), BendWeight(kLandHertz, secondsPerFrame), 1.0);
        for (size_t frame = 0; frame < free.size(); ++frame)
        {
            const auto sole = static_cast<double>(free[frame]);
            const auto share = static_cast<double>(landed[frame]);
            const double hovers = std::pow(share * heights[frame] / kHover, 4.0);
            rise.AddValue(frame, share > 0.0 ? kLandedWeight * (1.0 + hovers) : 0.0, -share * sole);
            rise.AddValue(frame, kDipWeight * Smoothstep(-sole / kFullDip), -sole);
        }
        heights = rise.Solve();
        for (size_t frame = 0; frame < heights.size(); ++frame)
            heights[frame] += static_cast<double>(free[frame]);
    }
    return heights;
}

} // namespace gw
