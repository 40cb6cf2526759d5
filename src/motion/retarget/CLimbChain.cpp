// Closed-form inverse kinematics for one limb.
//
// The problem: given the hip at the origin, an upper segment, a lower segment and a goal (position and
// rotation) for the ankle, find the rotations of hip, knee and ankle. The ankle has to reach six coordinates
// and the joints have seven degrees of freedom (3 + 1 + 3), so one of them is free: the limb can swivel
// around the line from hip to goal without moving the ankle. The caller fixes it with a hint, a point that
// the knee should be close to.
//
// The idea, in four steps:
// 1. ClampGoal. If the goal is farther away than the limb is long, it is moved toward the hip until it is
//    just within reach.
// 2. SolveKnee. The distance from hip to ankle depends only on the knee angle x. With row vectors it is |s ·
//    Ry(x) · U + t|, where s and t are the lower and the upper segment and U is the rotation of the upper
//    one. Squared, this becomes a cos x + b sin x = c, with two solutions around atan2(b, a). The first one
//    that is not negative is used.
// 3. Circle. The possible knee positions are the intersection of two spheres: around the hip with the upper
//    length, around the goal with the lower length. This is a circle about the line to the goal; the law of
//    cosines gives its center and radius. The hinge axis, projected onto the circle's plane, is at angle 0,
//    and the projection axis decides the direction of rotation. The hint selects the nearest point on the
//    circle.
// 4. SolveAtAngle. The hip rotation maps one frame onto another. In the limb's own pose, the frame is the
//    direction of the knee and the part of the ankle's position perpendicular to it. At the goal, it is the
//    chosen knee and the part of the goal's position perpendicular to that. The ankle's rotation is what is
//    then missing from the goal's rotation.
//
// Why it ends: there is no iteration; every step is a fixed number of operations. It fails if no knee angle
// of at least 0 reaches the goal, for example because the goal is closer than the difference of the segment
// lengths, or if joints coincide.
//
// The numbers guard against rounding of 32-bit inputs: a clamped goal stays one part in 100,000 short of full
// length, where knee and circle are still well defined; a cosine may exceed 1 by a millionth; and a
// perpendicular part shorter than a millionth of its vector has no usable direction. Straight limbs then use
// the limit of a vanishing bend.

#include "CLimbChain.h"

#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// A goal that is out of reach is moved to just short of the full length.
constexpr double kReachSlack = 1.00001;
// A cosine may exceed 1 by this much because of rounding: the limb is straight.
constexpr double kCosineRounding = 1e-6;
// If the part of a vector across an axis is shorter than this share of its length, it is rounding noise.
constexpr double kStraight = 1e-6;

bool HasDirection(const Vec3& across, const Vec3& whole)
{
    return Vec3Length(across) > kStraight * Vec3Length(whole);
}

Mat3 Rows(const Vec3& a, const Vec3& b, const Vec3& c)
{
    return {
        {a.x, a.y, a.z, b.x, b.y, b.z, c.x, c.y, c.z}
    };
}

Mat3 RotationOf(const Mat4& m)
{
    return Rows(m.Row(0), m.Row(1), m.Row(2));
}

// Solves a cos x + b sin x = c. Of the two solutions, returns the first one that is not negative.
bool FirstAngleNotNegative(double a, double b, double c, double& angle)
{
    const double amplitude = std::hypot(a, b);
    double cosine = c / amplitude;
    if (!(std::fabs(cosine) <= 1.0 + kCosineRounding))
        return false;
    cosine = std::clamp(cosine, -1.0, 1.0);
    const double middle = std::atan2(b, a);
    const double spread = std::acos(cosine);
    angle = middle + spread;
    if (angle > 0.0)
        return true;
    angle = middle - spread;
    return angle >= 0.0;
}

} // namespace

void CLimbChain::Init(const Mat4& upper, const Mat4& lower, const Vec3& axis, const Vec3& projection)
{
    upperMatrix = upper;
    lowerMatrix = lower;
    hingeAxis = axis;
    projectionAxis = projection;
    upperPosition = upper.Translation();
    upperLength = static_cast<float>(Vec3Length(upperPosition));
    upperLengthInverse = 1.0f / upperLength;
    lowerLength = static_cast<float>(Vec3Length(lower.Translation()));
    clampReach = true;
}

bool CLimbChain::ClampGoal(const Vec3& a, const Vec3& b, Vec3& goal)
{
    const double reach = Vec3Length(a) + Vec3Length(b);
    const double distance = Vec3Length(goal);
    if (!(distance > reach))
        return false;
    goal = goal * static_cast<float>(reach / (distance * kReachSlack));
    return true;
}

void CLimbChain::Circle()
{
    circleRadius = 0.0f;
    circleCentre = circleU = circleV = kVec3Zero;
    circleN = Vec3Normalized(goalPosition);
    const double d = Vec3Length(goalPosition);
    const double a = upperLength;
    const double b = lowerLength;
    const double c = (d * d + a * a - b * b) / (2.0 * d * a);
    if (!(std::fabs(c) <= 1.0 + kCosineRounding))
        return;
    const double theta = std::acos(std::clamp(c, -1.0, 1.0));
    circleCentre = circleN * static_cast<float>(std::cos(theta) * a);
    circleRadius = static_cast<float>(std::sin(theta) * a);
    if (Vec3Dot(circleN, projectionAxis) < 0.0)
        circleN = -circleN;
    const Vec3 u = Across(hingeAxis, circleN);
    circleU = Vec3Normalized(HasDirection(u, hingeAxis) ? u : Across(projectionAxis, circleN));
    circleV = Vec3Cross(circleN, circleU);
}

bool CLimbChain::SolveKnee()
{
    const Vec3 s = lowerMatrix.Translation();
    const Vec3& t = upperPosition;
    const double r0 = Vec3Dot(upperMatrix.Row(0), t);
    const double r1 = Vec3Dot(upperMatrix.Row(1), t);
    const double r2 = Vec3Dot(upperMatrix.Row(2), t);
    const double a = 2.0 * (s.x * r0 + s.z * r2);
    const double b = 2.0 * (s.z * r0 - s.x * r2);
    const double c = Vec3Dot(goalPosition, goalPosition) - Vec3Dot(s, s) - Vec3Dot(t, t) - 2.0 * s.y * r1;
    double angle = 0.0;
    if (!FirstAngleNotNegative(a, b, c, angle))
        return false;
    kneeAngle = static_cast<float>(angle);
    return true;
}

bool CLimbChain::SetGoal(const Mat4& newGoal)
{
    goal = newGoal;
    goalPosition = goal.Translation();
    if (clampReach && ClampGoal(upperPosition, lowerMatrix.Translation(), goalPosition))
        goal.SetTranslation(goalPosition);
    Circle();
    if (!SolveKnee())
        return false;
    const Mat4 knee = Mat4Compose(Mat3FromAxisAngle(kVec3UnitY, kneeAngle), kVec3Zero);
    chainMatrix = lowerMatrix * knee * upperMatrix;
    chainPosition = chainMatrix.Translation();
    return true;
}

float CLimbChain::KneeAngleFromHint(const Vec3& hint) const
{
    const Vec3 across = Across(hint - circleCentre, circleN);
    const double sine = Vec3Dot(circleN, Vec3Cross(circleU, across));
    return static_cast<float>(std::atan2(sine, Vec3Dot(circleU, across)));
}

Vec3 CLimbChain::KneePoint(float angle) const
{
    const double radius = circleRadius;
    return circleCentre + circleU * static_cast<float>(std::cos(static_cast<double>(angle)) * radius) +
           circleV * static_cast<float>(std::sin(static_cast<double>(angle)) * radius);
}

bool CLimbChain::SolveAtAngle(float angle, Mat3& hip, Mat3& ankle) const
{
    const Vec3 a = upperPosition * upperLengthInverse;
    Vec3 b = Across(chainPosition, a);
    // A straight limb is treated as the limit of a vanishing bend: the lower segment turns toward -X, and the
    // ankle is on the other side of the line than the knee.
    if (!HasDirection(b, chainPosition))
        b = Across(-kVec3UnitX, a);
    b = Vec3Normalized(b);

    const Vec3 knee = Vec3Normalized(KneePoint(angle));
    Vec3 toGoal = Across(goalPosition, knee);
    if (!HasDirection(toGoal, goalPosition))
    {
        const double x = static_cast<double>(angle);
        toGoal = -Across(
            circleU * static_cast<float>(std::cos(x)) + circleV * static_cast<float>(std::sin(x)), knee);
    }
    toGoal = Vec3Normalized(toGoal);
    if (knee == kVec3Zero || toGoal == kVec3Zero)
        return false;

    const Mat3 from = Mat3Transpose(Rows(a, b, Vec3Cross(a, b)));
    hip = from * Rows(knee, toGoal, Vec3Cross(knee, toGoal));
    ankle = RotationOf(goal) * Mat3Transpose(RotationOf(chainMatrix) * hip);
    return true;
}

} // namespace gw
