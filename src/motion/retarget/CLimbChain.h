#pragma once

#include "Mat4.h"

namespace gw {

/// A limb of three joints solved in closed form: a ball at the hip, a hinge at the knee, a ball at the ankle.
/// All in the solver's frame, which is the bones' frame turned by AxisSwapForward, with the hip at the
/// origin. Radians.
class CLimbChain
{
public:
    /// The upper and lower segment (only their translations matter), the hinge's axis, and the axis that
    /// tells which way round the knee's circle runs.
    void Init(const Mat4& upper, const Mat4& lower, const Vec3& axis, const Vec3& projection);
    /// Takes the goal of the limb's end, drawn in where it is out of reach, and finds the knee's circle and
    /// angle. False where no knee angle reaches it.
    bool SetGoal(const Mat4& newGoal);
    /// The angle on the knee's circle that is nearest to a point.
    float KneeAngleFromHint(const Vec3& hint) const;
    /// The knee's place at an angle on its circle.
    Vec3 KneePoint(float angle) const;
    /// The rotations of hip and ankle with the knee at an angle on its circle. False where they are not
    /// defined: goal, knee and hip in one point.
    bool SolveAtAngle(float angle, Mat3& hip, Mat3& ankle) const;

    bool clampReach = true;
    float kneeAngle = 0.0f;

    /// Draws a goal that lies farther from the origin than the lengths of `a` and `b` together in to just
    /// short of that. Returns whether it did.
    static bool ClampGoal(const Vec3& a, const Vec3& b, Vec3& goal);

private:
    void Circle();
    bool SolveKnee();

    Vec3 circleU = kVec3Zero;
    Vec3 circleV = kVec3Zero;
    Vec3 circleN = kVec3Zero;
    Vec3 circleCentre = kVec3Zero;
    float circleRadius = 0.0f;
    Vec3 hingeAxis = kVec3UnitZ;
    Vec3 projectionAxis = kVec3UnitX;
    Vec3 goalPosition = kVec3Zero;
    Vec3 chainPosition = kVec3Zero;
    Vec3 upperPosition = kVec3Zero;
    float upperLength = 0.0f;
    float lowerLength = 0.0f;
    float upperLengthInverse = 0.0f;
    Mat4 goal = kMat4Identity;
    Mat4 upperMatrix = kMat4Identity;
    Mat4 lowerMatrix = kMat4Identity;
    Mat4 chainMatrix = kMat4Identity;
};

} // namespace gw
