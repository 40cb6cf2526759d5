#pragma once

#include "Vec3.h"

#include <cstddef>

namespace gw {

/// A rotation or row basis: nine floats, row-major, element m[3r + c]. Row vectors multiply from the left, so
/// A · B applies A first. A positive angle about kVec3UnitZ rotates (1, 0, 0) to (cos a, sin a, 0).
struct Mat3
{
    float m[9];

    Vec3 Row(int row) const
    {
        const float* r = m + 3 * static_cast<ptrdiff_t>(row);
        return {r[0], r[1], r[2]};
    }
    void SetRow(int row, const Vec3& v)
    {
        float* r = m + 3 * static_cast<ptrdiff_t>(row);
        r[0] = v.x;
        r[1] = v.y;
        r[2] = v.z;
    }
    /// Exact comparison, element by element.
    friend bool operator==(const Mat3&, const Mat3&) = default;
};

inline constexpr Mat3 kMat3Identity{
    {1, 0, 0, 0, 1, 0, 0, 0, 1}
};

/// Returns the product; a acts first.
inline Mat3 operator*(const Mat3& a, const Mat3& b)
{
    Mat3 out;
    for (int row = 0; row < 3; ++row)
    {
        const float* r = a.m + 3 * static_cast<ptrdiff_t>(row);
        for (int column = 0; column < 3; ++column)
            out.m[3 * row + column] = r[0] * b.m[column] + r[1] * b.m[3 + column] + r[2] * b.m[6 + column];
    }
    return out;
}

/// Returns the transpose, which is the inverse of a rotation.
inline Mat3 Mat3Transpose(const Mat3& a)
{
    return {
        {a.m[0], a.m[3], a.m[6], a.m[1], a.m[4], a.m[7], a.m[2], a.m[5], a.m[8]}
    };
}

/// out := a · b; out may be a or b. Returns out.
Mat3& Mat3Multiply(const Mat3& a, const Mat3& b, Mat3& out);
/// Writes the rotation about an axis of unit length (not normalized here) by an angle in radians to out.
void Mat3FromAxisAngle(Mat3& out, const Vec3& axis, float angle);
Mat3 Mat3FromAxisAngle(const Vec3& axis, float angle);
/// Returns the inverse, or the identity if m is singular.
Mat3 Mat3InverseOrIdentity(const Mat3& a);

} // namespace gw
