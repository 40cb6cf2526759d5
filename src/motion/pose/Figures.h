#pragma once

#include "Vec3.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

/// Mean and maximum of a sequence of numbers; both are 0 for an empty sequence. Infinities and NaN, which
/// result from positions near the limits of a float, are ignored.
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

/// Returns `result` / `source`, or nothing if `source` is not above `least`, the largest value to which
/// rounding can turn 0.
inline std::optional<double> RatioOf(double result, double source, double least = 0.0)
{
    return source > least ? std::optional(result / source) : std::nullopt;
}

/// Returns 0 for x <= 0, 1 for x >= 1, and a smooth transition in between: 3 x^2 - 2 x^3.
double Smoothstep(double x);

/// Returns the nearest-rank percentile: the value below which a share (0 to 1) of the values lies. Non-finite
/// values are ignored. Returns 0 if there are no values.
float Percentile(std::vector<float> values, double share);

/// Returns the horizontal part of a vector: x and z, with y = 0.
inline Vec3 OverGround(const Vec3& way)
{
    return {way.x, 0.0f, way.z};
}
/// Returns the horizontal distance between two points, in x and z only.
double GroundDistance(const Vec3& a, const Vec3& b);

} // namespace gw
