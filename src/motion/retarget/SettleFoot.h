#pragma once

#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

/// Where the toe of the target's foot should be in a frame, in millimeters.
struct ToeWish
{
    Vec3 toe;       ///< vector from the ankle to the toe so far
    double below;   ///< how far the toe should be below the ankle while the foot stands
    double settled; ///< confidence, 0 to 1, that the foot stands and hardly moves
};

/// Returns by how much to lower the toe relative to its ankle, in millimeters, one value per frame. Changes
/// are smooth, and nothing is left of them in the swing.
std::vector<double> SettleFoot(std::span<const ToeWish> wishes, double secondsPerFrame);

} // namespace gw
