#include "CLimbChain.h"

#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// A goal out of reach is drawn in to just short of the full length.
constexpr double kReachSlack = 1.00001;
// A cosine this little beyond 1 is rounding: the limb is straight.
constexpr double kCosineRounding = 1e-6;
// Below this share of its length a vector's part across an axis is rounding and has no direction.
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

// The solutions of a cos x + b sin x = c, of which one that is not negative is wanted, the first before the
// second.
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
    // A straight limb is the limit of a vanishing bend: the shank leaves the thigh's line against X, and the
    // ankle lies on the other side of the line than the knee.
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
