#include "CAxis.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Returns the round step (1, 2 or 5 times a power of ten) that divides a range into about `count` steps.
double RoundStep(double range, int count)
{
    const double rough = range / count;
    const double power = std::pow(10.0, std::floor(std::log10(rough)));
    for (const double factor : {1.0, 2.0, 5.0})
    {
        if (factor * power >= rough)
            return factor * power;
    }
    return 10.0 * power;
}

} // namespace

CAxis::CAxis(double least, double largest, int count)
{
    // Curves are 32-bit: a range below their rounding error is treated as a constant curve.
    const double smallest = std::max(1e-6 * std::max(std::fabs(least), std::fabs(largest)), 1e-3);
    if (largest - least < smallest)
    {
        least -= smallest;
        largest += smallest;
    }
    m_fStep = RoundStep(largest - least, count);
    m_fLow = std::floor(least / m_fStep) * m_fStep;
    m_fHigh = std::ceil(largest / m_fStep) * m_fStep;
    m_iDecimals = std::max(0, -static_cast<int>(std::floor(std::log10(m_fStep))));
}

std::vector<double> CAxis::Ticks() const
{
    std::vector<double> ticks;
    const auto steps = std::lround((m_fHigh - m_fLow) / m_fStep);
    for (long i = 0; i <= steps; ++i)
        ticks.push_back(m_fLow + static_cast<double>(i) * m_fStep);
    return ticks;
}

} // namespace gw
