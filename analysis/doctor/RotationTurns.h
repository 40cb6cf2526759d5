#pragma once

#include <cmath>

namespace gw {

/// Returns the angle closest to another one that differs only by whole turns, in degrees.
inline float NearestTurn(float degrees, float to)
{
    return degrees + 360.0f * std::round((to - degrees) / 360.0f);
}

} // namespace gw
