#include "LandFoot.h"

#include "CBandFit.h"
#include "Figures.h"

namespace gw {

namespace {

constexpr double kFullDip = 20.0;      // millimeters below the floor at which kDipWeight applies in full
constexpr double kLandedWeight = 20.0; // weight of a sole that stands; the free path has weight 1
constexpr double kDipWeight = 10.0;    // weight of a sole below the floor: about a tenth of the dip stays

} // namespace

std::vector<double> LandFoot(std::span<const float> free, std::span<const float> landed,
                             double secondsPerFrame)
{
    CBandFit rise(free.size(), BendWeight(kReturnHertz, secondsPerFrame), 1.0);
    for (size_t frame = 0; frame < free.size(); ++frame)
    {
        const auto sole = static_cast<double>(free[frame]);
        const auto share = static_cast<double>(landed[frame]);
        rise.AddValue(frame, share > 0.0 ? kLandedWeight : 0.0, -share * sole);
        rise.AddValue(frame, kDipWeight * Smoothstep(-sole / kFullDip), -sole);
    }
    std::vector<double> heights = rise.Solve();
    for (size_t frame = 0; frame < heights.size(); ++frame)
        heights[frame] += static_cast<double>(free[frame]);
    return heights;
}

} // namespace gw
