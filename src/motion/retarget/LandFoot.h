#pragma once

#include <span>
#include <vector>

namespace gw {

/// Where the lower end of a foot's sole should be in a frame. Heights are in millimeters above the floor.
struct SoleWish
{
    float free;   ///< height if nothing holds the foot
    float landed; ///< confidence, 0 to 1, that the sole is on the floor
    float aloft;  ///< confidence, 0 to 1, that the foot is still without standing
    float least;  ///< least height of a foot that is aloft
};

/// Returns the height of the lower end of a foot's sole above the floor, in millimeters, one value per frame.
/// The sole is on the floor once it has landed, never far below it, and otherwise on its free path or higher.
std::vector<double> LandFoot(std::span<const SoleWish> wishes, double secondsPerFrame);

} // namespace gw
