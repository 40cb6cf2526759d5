#pragma once

namespace gw {

/// The lengths of the two segments of a leg or an arm.
struct LegLengths
{
    double upper;
    double lower;

    /// Returns the length of the straight limb.
    double Straight() const { return upper + lower; }
};

// The bend of a knee is the sine of half its angle: 0 for a straight leg, 1 for a folded one.

/// Stiffness of the target's knees, in millimeters per radian: they rotate by at most 0.8 degrees per
/// millimeter.
inline constexpr double kKneeStiffness = 75.0;

/// Returns the distance between hip and ankle at a given bend.
double ReachAt(const LegLengths& leg, double bend);
/// Returns the bend at which hip and ankle are `reach` apart, or 0 if the straight leg is shorter than that.
double BendAt(const LegLengths& leg, double reach);
/// Returns the square of the reach's derivative with respect to the knee's angle, per radian squared. The
/// derivative is also the distance of the knee from the line between hip and ankle.
double SquareSlopeAt(const LegLengths& leg, double bend);
/// Returns the bend of a leg that should reach `asked` but also keep its own bend. If the knee is bent, the
/// result reaches `asked`. If it is straight, the result stays close to `bend`, because there a small change
/// of reach takes a large angle. `stiffness` is a length per radian: each unit of length in `asked` rotates
/// the knee by at most its inverse.
double YieldingBend(const LegLengths& leg, double asked, double bend, double stiffness);

} // namespace gw
