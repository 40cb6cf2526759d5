#include "SmoothCurve.h"

#include <cmath>

namespace gw {

namespace {

// Exponential smoothing. One pass delays the curve; passes in both directions cancel the delay.
template <class TIterator>
void LeakyMean(TIterator value, TIterator end, double keep)
{
    double mean = static_cast<double>(*value);
    for (; value != end; ++value)
    {
        mean = keep * mean + (1.0 - keep) * static_cast<double>(*value);
        *value = static_cast<float>(mean);
    }
}

} // namespace

void SmoothCurve(std::span<float> curve, double frames)
{
    if (curve.empty() || !(frames > 0.0))
        return;
    // Two rounds: the kernel of a single one has a sharp peak, which lets noise through.
    const double keep = std::exp(-2.0 / frames);
    for (int round = 0; round < 2; ++round)
    {
        LeakyMean(curve.begin(), curve.end(), keep);
        LeakyMean(curve.rbegin(), curve.rend(), keep);
    }
}

} // namespace gw
