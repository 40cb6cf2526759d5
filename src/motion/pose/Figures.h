#pragma once

#include "Vec3.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

/// Mean and maximum of a sequence of numbers; both are 0 for an empty one. Infinities and NaN, as they result
/// from positions near the limits of a float, are ignored.
class CRunningMean
{
public:
    void Add(double value)
    {
        if (!std::isfinite(value))
            return;
        m_fLargest = m_uiCount == 0 ? value : std::max(m_fLargest, value);
        m_fSum += value;
        ++m_uiCount;
    }
    size_t Count() const { return m_uiCount; }
    double Sum() const { return m_fSum; }
    double Mean() const { return m_uiCount > 0 ? m_fSum / static_cast<double>(m_uiCount) : 0.0; }
    double Largest() const { return m_fLargest; }

private:
    double m_fSum = 0.0;
    double m_fLargest = 0.0;
    size_t m_uiCount = 0;
};

/// result / source; empty if the source's value is not above `least`, the largest value that rounding can
/// make of 0.
inline std::optional<double> RatioOf(double result, double source, double least = 0.0)
{
    return source > least ? std::optional(result / source) : std::nullopt;
}

/// 0 at and below 0, 1 at and above 1, and smooth in between.
double Smoothstep(double x);

/// The nearest-rank percentile: the value below which a share (0 to 1) of the values lies. 0 if there are no
/// values. Values that are not finite are ignored.
float Percentile(std::vector<float> values, double share);

/// The horizontal part of a way: in x and z only.
inline Vec3 OverGround(const Vec3& way)
{
    return {way.x, 0.0f, way.z};
}
/// The horizontal distance of two points: in x and z only.
double GroundDistance(const Vec3& a, const Vec3& b);

} // namespace gw
