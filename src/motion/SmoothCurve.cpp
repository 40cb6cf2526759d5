#include "SmoothCurve.h"

#include <cmath>
#include <ranges>

namespace gw {

namespace {

// A leaky mean is late by what it smooths; run once in each direction it is not.
void LeakyMean(auto&& values, double keep, double start)
{
    double mean = start;
    for (float& value : values)
    {
        mean = keep * mean + (1.0 - keep) * static_cast<double>(value);
        value = static_cast<float>(mean);
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
        LeakyMean(curve, keep, static_cast<double>(curve.front()));
        LeakyMean(curve | std::views::reverse, keep, static_cast<double>(curve.back()));
    }
}

} // namespace gw
