#include "Figures.h"

#include <cmath>

namespace gw {

float Percentile(std::vector<float> values, double share)
{
    std::erase_if(values, [](float value) { return !std::isfinite(value); });
    if (values.empty())
        return 0.0f;
    const auto last = static_cast<double>(values.size() - 1);
    const auto rank = values.begin() + std::lround(std::clamp(share, 0.0, 1.0) * last);
    std::nth_element(values.begin(), rank, values.end());
    return *rank;
}

double Smoothstep(double x)
{
    x = std::clamp(x, 0.0, 1.0);
    return x * x * (3.0 - 2.0 * x);
}

double GroundDistance(const Vec3& a, const Vec3& b)
{
    return std::hypot(static_cast<double>(a.x - b.x), static_cast<double>(a.z - b.z));
}

} // namespace gw
