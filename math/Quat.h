#pragma once

#include "Mat3.h"

#include <cmath>

namespace gw {

/// A rotation: four floats in the order w, x, y, z, in memory, in files and in all arguments.
struct Quat
{
    float w;
    float x;
    float y;
    float z;

    /// The imaginary part.
    Vec3 Imaginary() const { return {x, y, z}; }
    /// Exact comparison, element by element; q and -q are the same rotation and compare unequal.
    friend bool operator==(const Quat&, const Quat&) = default;
};

inline constexpr Quat kQuatIdentity{1.0f, 0.0f, 0.0f, 0.0f};

inline constexpr Quat kQuatZero{0.0f, 0.0f, 0.0f, 0.0f};

/// Multiplies all four components by s; the result is not normalized.
void QuatScale(const Quat& q, float s, Quat& out);
/// Writes the matrix of a unit quaternion; q is not normalized first.
void QuatToMat3(const Quat& q, Mat3& out);

inline Mat3 QuatToMat3(const Quat& q)
{
    const float xx = q.x * q.x * 2.0f;
    const float yy = q.y * q.y * 2.0f;
    const float zz = q.z * q.z * 2.0f;
    const float xy = q.x * q.y * 2.0f;
    const float xz = q.x * q.z * 2.0f;
    const float yz = q.y * q.z * 2.0f;
    const float xw = q.x * q.w * 2.0f;
    const float yw = q.y * q.w * 2.0f;
    const float zw = q.z * q.w * 2.0f;
    return {
        {1.0f - (zz + yy), xy + zw, xz - yw, xy - zw, 1.0f - (zz + xx), yz + xw, xz + yw, yz - xw,
         1.0f - (yy + xx)}
    };
}

/// The branch of QuatFromMat3 for rotations by about half a turn; starts from the largest diagonal element.
Quat QuatFromLargestDiagonal(const Mat3& m);
/// Writes the quaternion of a matrix with orthonormal rows. The rows are not orthonormalized here.
void QuatFromMat3(Quat& out, const Mat3& m);

inline Quat QuatFromMat3(const Mat3& matrix)
{
    const float* m = matrix.m;
    const double trace = static_cast<double>(m[0]) + m[8] + m[4];
    if (!(trace > 0.0))
        return QuatFromLargestDiagonal(matrix);
    const double s = std::sqrt(trace + 1.0);
    const double k = 0.5 / s;
    return {static_cast<float>(s * 0.5), static_cast<float>((static_cast<double>(m[5]) - m[7]) * k),
            static_cast<float>((static_cast<double>(m[6]) - m[2]) * k),
            static_cast<float>((static_cast<double>(m[1]) - m[3]) * k)};
}

/// Interpolates along the shorter arc from a (t = 0) to b (t = 1). t is not clamped, the result is not
/// normalized.
void QuatSlerp(Quat& out, float t, const Quat& a, const Quat& b);
Quat QuatSlerp(float t, const Quat& a, const Quat& b);

/// Interpolates repeatedly between the same two rotations, like QuatSlerp. The shared terms are computed
/// once.
class CQuatArc
{
public:
    CQuatArc(const Quat& a, const Quat& b);

    /// Returns QuatSlerp(t, a, b), bit for bit.
    Quat At(float t) const;

private:
    Quat m_kA;
    Quat m_kB;
    double m_fSign;
    double m_fTheta = 0.0;
    double m_fSinTheta = 0.0;
    bool m_bIsStraight = true; // too short for an arc: linear blend
};

} // namespace gw
