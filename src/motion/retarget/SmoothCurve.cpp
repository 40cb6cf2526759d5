#include "SmoothCurve.h"

#include "Figures.h"

#include <cmath>
#include <cstddef>
#include <vector>

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

void SteadySides(std::span<Vec3> sides, double far, double frames)
{
    std::vector<Vec3> smooth(sides.size());
    std::vector<float> curve(sides.size());
    for (Vec3& side : sides)
    {
        if (!std::isfinite(Vec3Dot(side, side)))
            side = kVec3Zero;
    }
    for (float Vec3::*axis : {&Vec3::x, &Vec3::y, &Vec3::z})
    {
        for (size_t frame = 0; frame < sides.size(); ++frame)
            curve[frame] = sides[frame].*axis;
        SmoothCurve(curve, frames);
        for (size_t frame = 0; frame < sides.size(); ++frame)
            smooth[frame].*axis = curve[frame];
    }
    for (size_t frame = 0; frame < sides.size(); ++frame)
    {
        const auto kept = static_cast<float>(Smoothstep(Vec3Length(sides[frame]) / far));
        sides[frame] = smooth[frame] + (sides[frame] - smooth[frame]) * kept;
    }
}

} // namespace gw
