#pragma once

#include "Vec3.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

/// Mean and largest value of numbers that come one by one. Both are 0 where none came. What is no finite
/// number, as positions near the end of 32 bits give, is passed over.
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

/// result / source, or nothing where the source's figure is not above `least`, which is what rounding can
/// make of 0.
inline std::optional<double> RatioOf(double result, double source, double least = 0.0)
{
    return source > least ? std::optional(result / source) : std::nullopt;
}

/// The value below which a share (0 to 1) of the values lies, by the nearest rank; 0 without values. Numbers
/// that are not finite do not count.
float Percentile(std::vector<float> values, double share);

/// The distance of two points over the ground: in x and z alone.
double GroundDistance(const Vec3& a, const Vec3& b);

} // namespace gw
