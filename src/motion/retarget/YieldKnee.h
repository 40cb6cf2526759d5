#pragma once

namespace gw {

/// A leg of two segments.
struct LegLengths
{
    double upper;
    double lower;
};

// A knee's bend is the sine of half its angle: 0 for a straight leg, 1 for one that is folded.

/// Millimetres a radian for knees and elbows of the target: they turn by at most 1.3 degrees for a
/// millimetre.
inline constexpr double kLimbStiffness = 45.0;

/// How far hip and ankle are apart with the knee bent.
double ReachAt(const LegLengths& leg, double bend);
/// The bend at which hip and ankle are so far apart; 0 for a reach beyond that of the straight leg.
double BendAt(const LegLengths& leg, double reach);
/// The square of what the reach loses for a radian more of the knee's angle.
double SquareSlopeAt(const LegLengths& leg, double bend);
/// The bend that a leg takes on which is asked for a reach but should keep its own bend: the one that reaches
/// it where the knee is bent, near to its own where it is straight, since there a little reach takes much of
/// an angle. `stiffness` is in units of length a radian: no millimetre asked for more or less turns the knee
/// by more than its inverse.
double YieldingBend(const LegLengths& leg, double asked, double bend, double stiffness);

} // namespace gw
