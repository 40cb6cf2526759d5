#pragma once

#include "Vec3.h"

namespace gw {

/// Turns a point so that an axis of the world points along +Y. `up` is a unit vector along an axis.
inline Vec3 UprightPoint(const Vec3& point, const Vec3& up)
{
    if (up.z != 0.0f)
        return {point.x, point.z * up.z, -point.y * up.z};
    if (up.x != 0.0f)
        return {-point.y * up.x, point.x * up.x, point.z};
    return up.y < 0.0f ? Vec3{point.x, -point.y, -point.z} : point;
}

} // namespace gw
