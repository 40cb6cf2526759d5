#include "SmoothCurve.h"

#include <cmath>

namespace gw {

namespace {

// A leaky mean is late by what it smooths; run once in each direction it is not.
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
    // Two rounds: the weights of one have a corner in the middle, which lets noise through.
    const double keep = std::exp(-2.0 / frames);
    for (int round = 0; round < 2; ++round)
    {
        LeakyMean(curve.begin(), curve.end(), keep);
        LeakyMean(curve.rbegin(), curve.rend(), keep);
    }
}

} // namespace gw
