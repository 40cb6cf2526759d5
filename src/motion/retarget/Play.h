#pragma once

#include "Vec3.h"

namespace gw {

/// The part of `way` that lies outside a dead zone of radius `play`.
inline Vec3 BeyondPlay(const Vec3& way, double play)
{
    const double distance = Vec3Length(way);
    return distance <= play ? kVec3Zero : way * static_cast<float>(1.0 - play / distance);
}

} // namespace gw
