#pragma once

#include <cmath>

namespace gw {

/// The angle that is nearest to another one and the same but for whole turns, in degrees.
inline float NearestTurn(float degrees, float to)
{
    return degrees + 360.0f * std::round((to - degrees) / 360.0f);
}

} // namespace gw
