#pragma once

#include "Mat4.h"

namespace gw {

/// Solves a limb of three joints in closed form: a ball joint at the hip, a hinge at the knee, a ball joint
/// at the ankle. All values are in the solver's frame, which is the bones' frame rotated by AxisSwapForward,
/// with the hip at the origin. Angles are radians.
class CLimbChain
{
public:
    /// Sets the upper and lower segment (only their translations matter), the hinge axis, and the axis that
    /// defines the direction of the knee's circle.
    void Init(const Mat4& upper, const Mat4& lower, const Vec3& axis, const Vec3& projection);
    /// Sets the goal of the limb's end, moved closer if it is out of reach, and computes the knee's circle
    /// and angle. Returns false if no knee angle reaches it.
    bool SetGoal(const Mat4& newGoal);
    /// The angle of the point on the knee's circle that is nearest to a point.
    float KneeAngleFromHint(const Vec3& hint) const;
    /// The knee's position at an angle on its circle.
    Vec3 KneePoint(float angle) const;
    /// Computes the rotations of hip and ankle for a knee position on the circle. Returns false if they are
    /// undefined, because goal, knee and hip coincide.
    bool SolveAtAngle(float angle, Mat3& hip, Mat3& ankle) const;

    bool clampReach = true;
    float kneeAngle = 0.0f;

    /// If a goal is farther from the origin than the lengths of `a` and `b` together, moves it to just within
    /// that distance. Returns whether it did.
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
