#include "Quat.h"

#include "Angles.h"

#include <cmath>
#include <cstddef>

namespace gw {

namespace {

// The branch for rotations of half a turn or nearly so: starts from the largest diagonal element.
Quat FromLargestDiagonal(const float* m)
{
    size_t i = m[0] < m[4] ? 1 : 0;
    if (m[4 * i] < m[8])
        i = 2;
    const size_t j = (i + 1) % 3;
    const size_t k = (i + 2) % 3;

    const double s = std::sqrt(static_cast<double>(m[4 * i]) - m[4 * j] - m[4 * k] + 1.0);
    const double r = 0.5 / s;
    float q[3];
    q[i] = static_cast<float>(s * 0.5);
    q[j] = static_cast<float>((static_cast<double>(m[3 * i + j]) + m[3 * j + i]) * r);
    q[k] = static_cast<float>((static_cast<double>(m[3 * i + k]) + m[3 * k + i]) * r);
    const float w = static_cast<float>((static_cast<double>(m[3 * j + k]) - m[3 * k + j]) * r);
    return {w, q[0], q[1], q[2]};
}

} // namespace

void QuatScale(const Quat& q, float s, Quat& out)
{
    out = {q.w * s, q.x * s, q.y * s, q.z * s};
}

Mat3 QuatToMat3(const Quat& q)
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

void QuatToMat3(const Quat& q, Mat3& out)
{
    out = QuatToMat3(q);
}

Quat QuatFromMat3(const Mat3& matrix)
{
    const float* m = matrix.m;
    const double trace = static_cast<double>(m[0]) + m[8] + m[4];
    if (!(trace > 0.0))
        return FromLargestDiagonal(m);
    const double s = std::sqrt(trace + 1.0);
    const double k = 0.5 / s;
    return {static_cast<float>(s * 0.5), static_cast<float>((static_cast<double>(m[5]) - m[7]) * k),
            static_cast<float>((static_cast<double>(m[6]) - m[2]) * k),
            static_cast<float>((static_cast<double>(m[1]) - m[3]) * k)};
}

void QuatFromMat3(Quat& out, const Mat3& m)
{
    out = QuatFromMat3(m);
}

Quat QuatSlerp(float t, const Quat& a, const Quat& b)
{
    const double d = static_cast<double>(a.w) * b.w + static_cast<double>(a.x) * b.x +
                     static_cast<double>(a.y) * b.y + static_cast<double>(a.z) * b.z;
    const double sign = d < 0.0 ? -1.0 : 1.0;
    const double c = sign * d;
    double k0 = 1.0 - static_cast<double>(t);
    double k1 = static_cast<double>(t);
    if (1.0 - c > kEpsilon)
    {
        const double sinTheta = std::sqrt(1.0 - c * c);
        const double theta = std::atan2(sinTheta, c);
        k0 = std::sin(theta * k0) / sinTheta;
        k1 = std::sin(theta * k1) / sinTheta;
    }
    k1 *= sign;
    return {static_cast<float>(k0 * a.w + k1 * b.w), static_cast<float>(k0 * a.x + k1 * b.x),
            static_cast<float>(k0 * a.y + k1 * b.y), static_cast<float>(k0 * a.z + k1 * b.z)};
}

void QuatSlerp(Quat& out, float t, const Quat& a, const Quat& b)
{
    out = QuatSlerp(t, a, b);
}

} // namespace gw
