#pragma once

#include "Vec3.h"

#include <cstddef>

namespace gw {

/// Returns the component of a vector along X (0), Y (1) or Z (2).
inline float AlongAxis(const Vec3& v, size_t axis)
{
    return axis == 0 ? v.x : axis == 1 ? v.y : v.z;
}

} // namespace gw
