#pragma once

#include <span>
#include <vector>

namespace gw {

/// Heights of the lower end of a foot's sole over the floor, frame by frame, in millimetres: on the floor
/// where it has landed, hardly below it anywhere, and else on its free path. `free` is that path, if nothing
/// held the foot; `landed` tells 0 to 1 how surely the sole is on the floor.
std::vector<double> LandFoot(std::span<const float> free, std::span<const float> landed,
                             double secondsPerFrame);

} // namespace gw
