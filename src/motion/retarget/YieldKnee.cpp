// A leg must both reach a position and keep its knee angle. The reach r as a function of the knee's angle x
// is flat near the straight leg. There, the angle that reaches a position exactly grows with the square root
// of the missing length, so a foot that rocks by a millimeter jerks the knee. A spring between angle and
// reach does not help: it has two equilibria, and the knee flips from one to the other at some length.
//
// So the knee moves from its own angle to the result along the change in reach, and rotates by at most 1 / s
// per unit of it, for a stiffness s:
//
//     dx / de = 1 / sqrt(r'(x)^2 + s^2)        e = r at its own angle - the requested reach
//
// The result is the exact angle where |r'| is large, and changes evenly where it is not. A knee that
// straightens is slowed down in its last degrees, so it approaches its stop and never hits it. The equation
// is integrated with Heun's method in a few steps, which is enough because bends are small and the right-hand
// side is smooth. A knee that bends far is a few millimeters short, because it started where |r'| was small.
// It is then moved toward the exact angle, and the more so the larger |r'| is there.
//
// With y = sin(x / 2) instead of the angle, and a and b for the segments, the law of cosines becomes
//
//     r^2 = (a + b)^2 - 4 a b y^2        r' = -2 a b y sqrt(1 - y^2) / r        dy / dx = sqrt(1 - y^2) / 2
//
// which needs no trigonometry and keeps small angles exact.

#include "YieldKnee.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr int kSteps = 4;
constexpr double kStopBend = 0.06;    // a knee slows down in the last 7 degrees before its stop
constexpr double kLeastBend = 0.005;  // below this, rounding dominates
constexpr double kExactSlope = 110.0; // millimeters per radian; a knee of 36 degrees is half exact
constexpr double kMostBend = 0.9999;

// Returns the change of the bend per unit of length in `direction`: 1 shortens the leg, -1 straightens it.
double BendFor(const LegLengths& leg, double bend, double slowBelow, double stiffness, double direction)
{
    const double turn =
        0.5 * std::sqrt((1.0 - bend * bend) / (SquareSlopeAt(leg, bend) + stiffness * stiffness));
    return direction < 0.0 ? -turn * std::min(bend / slowBelow, 1.0) : turn;
}

double SquareReachAt(const LegLengths& leg, double bend)
{
    const double straight = leg.Straight();
    return straight * straight - 4.0 * leg.upper * leg.lower * bend * bend;
}

} // namespace

double ReachAt(const LegLengths& leg, double bend)
{
    return std::sqrt(std::max(SquareReachAt(leg, bend), 0.0));
}

double BendAt(const LegLengths& leg, double reach)
{
    const double straight = leg.Straight();
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
    const double shorter = ReachAt(leg, bend) - std::clamp(asked, 0.0, 2.0 * leg.Straight());
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
    const double slope = SquareSlopeAt(leg, taken) / (kExactSlope * kExactSlope);
    taken += slope * slope / (slope * slope + 1.0) * (BendAt(leg, asked) - taken);
    return std::sqrt(taken * taken + kLeastBend * kLeastBend);
}

} // namespace gw
