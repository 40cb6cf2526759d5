#include "BoundSphere.h"

#include <algorithm>
#include <cmath>

namespace gw {

void BoundSphere::Merge(const BoundSphere& other)
{
    constexpr double kSameCentre = 1e-6;
    const Vec3 d = m_kCentre - other.m_kCentre;
    const double squared = Vec3Dot(d, d);
    const double r = static_cast<double>(other.m_fRadius) - m_fRadius;
    if (r * r >= squared)
    {
        if (r >= 0.0)
            *this = other;
        return;
    }
    const double length = std::sqrt(squared);
    if (length > kSameCentre)
        m_kCentre = other.m_kCentre + d * static_cast<float>((length - r) * 0.5 / length);
    m_fRadius = static_cast<float>((static_cast<double>(m_fRadius) + other.m_fRadius + length) * 0.5);
}

BoundSphere BoundOfPoints(std::span<const Vec3> points)
{
    if (points.empty())
        return {};
    Vec3 low = points[0];
    Vec3 high = points[0];
    for (const Vec3& p : points)
    {
        low = {std::min(low.x, p.x), std::min(low.y, p.y), std::min(low.z, p.z)};
        high = {std::max(high.x, p.x), std::max(high.y, p.y), std::max(high.z, p.z)};
    }
    BoundSphere bound{(low + high) * 0.5f, 0.0f};
    double squared = 0.0;
    for (const Vec3& p : points)
    {
        const Vec3 d = p - bound.m_kCentre;
        squared = std::max(squared, Vec3Dot(d, d));
    }
    bound.m_fRadius = static_cast<float>(std::sqrt(squared));
    return bound;
}

} // namespace gw
