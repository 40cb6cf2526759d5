#pragma once

#include "Vec3.h"

namespace gw {

/// How far something is led by what goes a way off, with some play between the two.
inline Vec3 BeyondPlay(const Vec3& way, double play)
{
    const double distance = Vec3Length(way);
    return distance <= play ? kVec3Zero : way * static_cast<float>(1.0 - play / distance);
}

} // namespace gw
