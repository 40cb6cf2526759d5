#pragma once

#include "Mat3.h"

#include <cmath>
#include <cstddef>

namespace gw {

/// m := R · m for the rotation R about one axis (0 X, 1 Y, 2 Z) by an angle in radians. Such a rotation
/// changes two rows of m only, so that this takes a third of a matrix product; the result is that of
/// Mat3FromAxisAngle and Mat3Multiply within rounding.
inline void RotateRows(Mat3& m, size_t axis, float radians)
{
    const float c = std::cos(radians);
    const float s = std::sin(radians);
    float* const a = &m.m[3 * ((axis + 1) % 3)];
    float* const b = &m.m[3 * ((axis + 2) % 3)];
    for (int column = 0; column < 3; ++column)
    {
        const float x = a[column];
        const float y = b[column];
        a[column] = c * x + s * y;
        b[column] = c * y - s * x;
    }
}

} // namespace gw
