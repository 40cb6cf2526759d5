// What a leg does that must both reach a place and keep its knee. With the reach r(x) at the knee's angle x,
// the place at a distance d and the angle k to keep, it minimises
//
//     (r(x) - d)^2 + (s (x - k))^2
//
// for a stiffness s. Newton's steps, of whose second derivative only the parts above 0 are kept, go down all
// the way; a few are enough, since angles are small and the function is nearly a parabola.

#include "YieldKnee.h"

#include "Angles.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr int kSteps = 6;

} // namespace

double ReachAt(const LegLengths& leg, double kneeAngle)
{
    const double square =
        leg.upper * leg.upper + leg.lower * leg.lower + 2.0 * leg.upper * leg.lower * std::cos(kneeAngle);
    return std::sqrt(std::max(square, 0.0));
}

double AngleAt(const LegLengths& leg, double reach)
{
    const double cosine =
        (reach * reach - leg.upper * leg.upper - leg.lower * leg.lower) / (2.0 * leg.upper * leg.lower);
    return std::acos(std::clamp(cosine, -1.0, 1.0));
}

double ReachSlope(const LegLengths& leg, double kneeAngle)
{
    const double reach = ReachAt(leg, kneeAngle);
    return reach > 0.0 ? -leg.upper * leg.lower * std::sin(kneeAngle) / reach : 0.0;
}

double YieldingReach(const LegLengths& leg, double asked, double kneeAngle, double stiffness)
{
    const double square = stiffness * stiffness;
    double angle = kneeAngle;
    for (int step = 0; step < kSteps; ++step)
    {
        const double reach = ReachAt(leg, angle);
        const double slope = ReachSlope(leg, angle);
        const double bend = reach > 0.0 ? -leg.upper * leg.lower * std::cos(angle) / reach : 0.0;
        const double gradient = (reach - asked) * slope + square * (angle - kneeAngle);
        const double curvature = slope * slope + square + std::max(0.0, (reach - asked) * bend);
        angle = std::clamp(angle - gradient / curvature, 0.0, kPi64);
    }
    return ReachAt(leg, angle);
}

} // namespace gw
