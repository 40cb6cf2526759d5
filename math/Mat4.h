#pragma once

#include "Angles.h"
#include "Mat3.h"

namespace gw {

/// A transform: sixteen floats, row-major, translation in the last row, last column 0, 0, 0, 1.
struct Mat4
{
    float m[16];

    /// Returns the first three elements of a row; row 3 is the translation.
    Vec3 Row(int row) const
    {
        const float* r = m + 4 * static_cast<ptrdiff_t>(row);
        return {r[0], r[1], r[2]};
    }
    Vec3 Translation() const { return Row(3); }
    void SetTranslation(const Vec3& v)
    {
        m[12] = v.x;
        m[13] = v.y;
        m[14] = v.z;
    }
    /// Exact comparison, element by element.
    friend bool operator==(const Mat4&, const Mat4&) = default;
};

inline constexpr Mat4 kMat4Identity{
    {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1}
};

inline constexpr Mat4 kMat4Zero{};

/// From the bones' frame to the limb solver's frame and back: signed permutations, inverse to each other.
inline constexpr Mat4 AxisSwapForward{
    {0, -1, 0, 0, 0, 0, -1, 0, 1, 0, 0, 0, 0, 0, 0, 1}
};

inline constexpr Mat4 AxisSwapBack{
    {0, 0, 1, 0, -1, 0, 0, 0, 0, -1, 0, 0, 0, 0, 0, 1}
};

/// out := S · R · T. A null input means kMat3Identity, kVec3Zero or kVec3One.
void Mat4Compose(Mat4& out, const Mat3* rotation, const Vec3* translation, const Vec3* scale);

inline Mat4 Mat4Compose(const Mat3& rotation, const Vec3& translation, const Vec3& scale = kVec3One)
{
    const float* r = rotation.m;
    return {
        {r[0] * scale.x, r[1] * scale.x, r[2] * scale.x, 0.0f, r[3] * scale.y, r[4] * scale.y, r[5] * scale.y,
         0.0f, r[6] * scale.z, r[7] * scale.z, r[8] * scale.z, 0.0f, translation.x, translation.y,
         translation.z, 1.0f}
    };
}

/// out := a · b; out may be a or b. If any pointer is null, nothing is written and null is returned.
Mat4* Mat4Multiply(Mat4* out, const Mat4* a, const Mat4* b);

inline Mat4 operator*(const Mat4& a, const Mat4& b)
{
    Mat4 out;
    for (int row = 0; row < 4; ++row)
    {
        const float* r = a.m + 4 * static_cast<ptrdiff_t>(row);
        for (int column = 0; column < 4; ++column)
            out.m[4 * row + column] = r[0] * b.m[column] + r[1] * b.m[4 + column] + r[2] * b.m[8 + column] +
                                      r[3] * b.m[12 + column];
    }
    return out;
}

/// Writes the inverse of m to out. Returns null and leaves out unchanged if the determinant is 0 or its
/// reciprocal is not finite in 32 bits. `determinant`, if not null, is written in either case.
Mat4* Mat4Inverse(Mat4* out, float* determinant, const Mat4* m);
/// Returns the inverse, or the identity if m is singular.
Mat4 Mat4InverseOrIdentity(const Mat4& m);

/// Writes (v, 1) · m to out, divided by its fourth element unless that is 1 within kEpsilon. Returns null if
/// a pointer is null.
Vec3* TransformCoord(Vec3* out, const Vec3* v, const Mat4* m);

inline Vec3 TransformCoord(const Vec3& v, const Mat4& matrix)
{
    const float* m = matrix.m;
    const Vec3 p{v.x * m[0] + v.y * m[4] + v.z * m[8] + m[12], v.x * m[1] + v.y * m[5] + v.z * m[9] + m[13],
                 v.x * m[2] + v.y * m[6] + v.z * m[10] + m[14]};
    const float w = v.x * m[3] + v.y * m[7] + v.z * m[11] + m[15];
    if (std::fabs(w - 1.0f) <= kEpsilon)
        return p;
    return p * (1.0f / w);
}

/// Returns the lengths of the first three rows: the scale of a transform.
inline Vec3 RowLengths(const Mat4& m)
{
    return {static_cast<float>(Vec3Length(m.Row(0))), static_cast<float>(Vec3Length(m.Row(1))),
            static_cast<float>(Vec3Length(m.Row(2)))};
}

/// Returns the first three rows divided by their lengths: the rotation of a transform. A row of length 0
/// stays as it is.
inline Mat3 NormalizedRows(const Mat4& m)
{
    Mat3 out;
    for (int row = 0; row < 3; ++row)
        out.SetRow(row, Vec3Normalized(m.Row(row)));
    return out;
}

} // namespace gw
