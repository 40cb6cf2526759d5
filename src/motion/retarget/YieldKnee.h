#pragma once

namespace gw {

/// A leg of two segments.
struct LegLengths
{
    double upper;
    double lower;
};

/// How far hip and ankle are apart with the knee bent by an angle in radians, 0 for a straight leg.
double ReachAt(const LegLengths& leg, double kneeAngle);
/// The knee's angle at which hip and ankle are so far apart; 0 for a reach beyond that of the straight leg.
double AngleAt(const LegLengths& leg, double reach);
/// What the reach gains for a radian more of the knee's angle; never above 0.
double ReachSlope(const LegLengths& leg, double kneeAngle);
/// The reach that a leg takes on which is asked for one but should keep its knee's angle: near to the one
/// asked for where the knee is bent, near to its own where it is straight, since there a little reach takes
/// much of an angle. `stiffness` is in units of length a radian: where the slope is less, the knee is kept.
double YieldingReach(const LegLengths& leg, double asked, double kneeAngle, double stiffness);

} // namespace gw
