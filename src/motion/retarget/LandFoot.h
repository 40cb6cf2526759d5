#pragma once

#include <span>
#include <vector>

namespace gw {

/// Returns the height of the lower end of a foot's sole above the floor, in millimeters, one value per frame.
/// The sole is on the floor once it has landed, never far below it, and otherwise on its free path. `free`
/// contains the heights if nothing holds the foot; `landed` is the confidence, 0 to 1, that the sole is on
/// the floor. Both have one value per frame.
std::vector<double> LandFoot(std::span<const float> free, std::span<const float> landed,
                             double secondsPerFrame);

} // namespace gw
