// What a leg does that must both reach a place and keep its knee. Its reach r at the knee's angle x is flat
// where the leg is straight: there the angle that reaches a place exactly goes as the square root of what is
// missing, and a foot that rocks by a millimetre jerks the knee. A spring between angle and reach does not
// help: which of its two balances the knee takes flips at some length.
//
// So the knee goes from its own angle to the one it takes by steps of the reach, and turns for each of them
// by no more than 1 / s for a stiffness s:
//
//     dx / de = 1 / sqrt(r'(x)^2 + s^2)        e = r at its own angle - the reach asked for
//
// That is the exact angle where |r'| is large, and one that changes evenly where it is not. A knee that
// straightens is slowed down in its last degrees: it comes near to its stop and never hits it. The curve is
// followed by Heun's rule in a few steps; bends are small and the right side is smooth.
//
// With y = sin(x / 2) for the angle, and a and b for the segments, the law of cosines becomes
//
//     r^2 = (a + b)^2 - 4 a b y^2        r' = -2 a b y sqrt(1 - y^2) / r        dy / dx = sqrt(1 - y^2) / 2
//
// which takes no trigonometry and keeps small angles exact.

#include "YieldKnee.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr int kSteps = 4;
constexpr double kStopBend = 0.06;   // 7 degrees before its stop a knee begins to slow down
constexpr double kLeastBend = 0.005; // a straighter leg is one of which rounding makes what it likes
constexpr double kMostBend = 0.9999;

// By how much a bend grows for a unit of length less.
double BendFor(const LegLengths& leg, double bend, double slowBelow, double stiffness, double direction)
{
    const double turn =
        0.5 * std::sqrt((1.0 - bend * bend) / (SquareSlopeAt(leg, bend) + stiffness * stiffness));
    return direction < 0.0 ? -turn * std::min(bend / slowBelow, 1.0) : turn;
}

double SquareReachAt(const LegLengths& leg, double bend)
{
    const double straight = leg.upper + leg.lower;
    return straight * straight - 4.0 * leg.upper * leg.lower * bend * bend;
}

} // namespace

double ReachAt(const LegLengths& leg, double bend)
{
    return std::sqrt(std::max(SquareReachAt(leg, bend), 0.0));
}

double BendAt(const LegLengths& leg, double reach)
{
    const double straight = leg.upper + leg.lower;
    const double square = (straight * straight - reach * reach) / (4.0 * leg.upper * leg.lower);
    return std::sqrt(std::clamp(square, 0.0, 1.0));
}

double SquareSlopeAt(const LegLengths& leg, double bend)
{
    const double square = SquareReachAt(leg, bend);
    const double across = 2.0 * leg.upper * leg.lower * bend;
    return square > 0.0 ? across * across * (1.0 - bend * bend) / square : 0.0;
}

double YieldingBend(const LegLengths& leg, double asked, double bend, double stiffness)
{
    const double shorter = ReachAt(leg, bend) - std::clamp(asked, 0.0, 2.0 * (leg.upper + leg.lower));
    const double direction = shorter < 0.0 ? -1.0 : 1.0;
    const double slowBelow = std::max(std::min(kStopBend, bend), 1e-9);
    const double step = std::fabs(shorter) / kSteps;
    double taken = bend;
    for (int i = 0; i < kSteps; ++i)
    {
        const double first = BendFor(leg, taken, slowBelow, stiffness, direction);
        const double ahead = std::clamp(taken + step * first, 0.0, kMostBend);
        const double second = BendFor(leg, ahead, slowBelow, stiffness, direction);
        taken = std::clamp(taken + 0.5 * step * (first + second), 0.0, kMostBend);
    }
    return std::sqrt(taken * taken + kLeastBend * kLeastBend);
}

} // namespace gw
