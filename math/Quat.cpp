#include "Quat.h"

#include "Angles.h"

#include <cmath>
#include <cstddef>

namespace gw {

Quat QuatFromLargestDiagonal(const Mat3& matrix)
{
    const float* m = matrix.m;
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

void QuatScale(const Quat& q, float s, Quat& out)
{
    out = {q.w * s, q.x * s, q.y * s, q.z * s};
}

void QuatToMat3(const Quat& q, Mat3& out)
{
    out = QuatToMat3(q);
}

void QuatFromMat3(Quat& out, const Mat3& m)
{
    out = QuatFromMat3(m);
}

CQuatArc::CQuatArc(const Quat& a, const Quat& b) : m_kA(a), m_kB(b)
{
    const double d = static_cast<double>(a.w) * b.w + static_cast<double>(a.x) * b.x +
                     static_cast<double>(a.y) * b.y + static_cast<double>(a.z) * b.z;
    m_fSign = d < 0.0 ? -1.0 : 1.0;
    const double c = m_fSign * d;
    if (1.0 - c > kEpsilon)
    {
        m_fSinTheta = std::sqrt(1.0 - c * c);
        m_fTheta = std::atan2(m_fSinTheta, c);
        m_bIsStraight = false;
    }
}

Quat CQuatArc::At(float t) const
{
    double k0 = 1.0 - static_cast<double>(t);
    double k1 = static_cast<double>(t);
    if (!m_bIsStraight)
    {
        k0 = std::sin(m_fTheta * k0) / m_fSinTheta;
        k1 = std::sin(m_fTheta * k1) / m_fSinTheta;
    }
    k1 *= m_fSign;
    const Quat& a = m_kA;
    const Quat& b = m_kB;
    return {static_cast<float>(k0 * a.w + k1 * b.w), static_cast<float>(k0 * a.x + k1 * b.x),
            static_cast<float>(k0 * a.y + k1 * b.y), static_cast<float>(k0 * a.z + k1 * b.z)};
}

Quat QuatSlerp(float t, const Quat& a, const Quat& b)
{
    return CQuatArc(a, b).At(t);
}

void QuatSlerp(Quat& out, float t, const Quat& a, const Quat& b)
{
    out = QuatSlerp(t, a, b);
}

} // namespace gw
