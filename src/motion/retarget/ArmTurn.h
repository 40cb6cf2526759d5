#pragma once

#include "Vec3.h"
#include "YieldKnee.h"

namespace gw {

/// How an arm is moved away from a pose: its shoulder moves with the collar bone, all of the arm rotates
/// about the shoulder, and the elbow bends more or less while the hand stays on its line from the shoulder.
struct ArmTurn
{
    Vec3 turn = kVec3Zero; ///< rotation vector in world space, in radians
    double bend = 0.0;     ///< change of the elbow's angle in radians; positive folds the arm
    double raise = 0.0;    ///< shift of the shoulder along the chest's up axis, in lengths of the collar bone
};

/// Returns the distance between shoulder and hand at an angle of the elbow, 0 for a straight arm.
double ReachAtElbow(const LegLengths& arm, double elbow);
/// Returns the elbow's angle in radians if hand and shoulder are `reach` apart.
double ElbowAt(const LegLengths& arm, double reach);
/// Returns a vector rotated by a rotation vector in radians: about the vector's direction, by its length.
Vec3 Rotated(const Vec3& v, const Vec3& turn);

/// Returns the vector from collar joint to shoulder after a turn, given the chest's up axis in world space.
/// It keeps its length.
Vec3 TurnedCollar(const Vec3& collar, const Vec3& up, const ArmTurn& turn);
/// Returns the vector from shoulder to hand after a turn. The elbow never bends backward, nor so far that the
/// arm folds into itself, unless it does so already.
Vec3 TurnedHand(const LegLengths& arm, const Vec3& hand, const ArmTurn& turn);

} // namespace gw
