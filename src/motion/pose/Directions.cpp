// Angles and rotations between directions. Angles are computed from sine and cosine together, because the arc
// cosine of a float cannot resolve angles below a fiftieth of a degree.

#include "Directions.h"

#include "Angles.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kNoLength = 1e-9;

// Returns a unit vector perpendicular to a direction.
Vec3 AnyAcross(const Vec3& direction)
{
    const Vec3 unit = Vec3Normalized(direction);
    const Vec3 across = Across(kVec3UnitZ, unit);
    return Vec3Normalized(Vec3Length(across) > 0.5 ? across : Across(kVec3UnitX, unit));
}

} // namespace

Vec3 Turned(const Vec3& direction, const Mat3& turn)
{
    return turn.Row(0) * direction.x + turn.Row(1) * direction.y + turn.Row(2) * direction.z;
}

Vec3 ToLocal(const Vec3& direction, const Mat3& axes)
{
    return {static_cast<float>(Vec3Dot(direction, axes.Row(0))),
            static_cast<float>(Vec3Dot(direction, axes.Row(1))),
            static_cast<float>(Vec3Dot(direction, axes.Row(2)))};
}

Mat3 TurnAbout(const Vec3& axis, double degrees)
{
    return Mat3FromAxisAngle(axis, static_cast<float>(degrees * kDegreesToRadians64));
}

Mat3 LeastSwing(const Vec3& from, const Vec3& to)
{
    const Vec3 a = Vec3Normalized(from);
    const Vec3 b = Vec3Normalized(to);
    if (a == kVec3Zero || b == kVec3Zero)
        return kMat3Identity;
    const Vec3 cross = Vec3Cross(a, b);
    const double sine = Vec3Length(cross);
    const double angle = std::atan2(sine, Vec3Dot(a, b));
    const Vec3 axis = sine > kNoLength ? Vec3Normalized(cross) : AnyAcross(a);
    return Mat3FromAxisAngle(axis, static_cast<float>(angle));
}

Mat3 TurnUpright(const Vec3& up, const Vec3& left)
{
    const Vec3 y = Vec3Normalized(up);
    if (y == kVec3Zero)
        return kMat3Identity;
    const Vec3 across = Across(Vec3Normalized(left), y);
    const Vec3 x = Vec3Length(across) > 1e-3 ? Vec3Normalized(across) : AnyAcross(y);
    Mat3 rows;
    rows.SetRow(0, x);
    rows.SetRow(1, y);
    rows.SetRow(2, Vec3Cross(x, y));
    return Mat3Transpose(rows);
}

double TwistBetween(const Vec3& from, const Vec3& to, const Vec3& axis)
{
    const Vec3 a = Across(from, axis);
    const Vec3 b = Across(to, axis);
    return std::atan2(Vec3Dot(Vec3Cross(a, b), axis), Vec3Dot(a, b)) * kRadiansToDegrees64;
}

// From sine and cosine together: the arc cosine of floats cannot resolve angles below a fiftieth of a degree.
double AngleBetween(const Vec3& a, const Vec3& b)
{
    return std::atan2(Vec3Length(Vec3Cross(a, b)), Vec3Dot(a, b)) * kRadiansToDegrees64;
}

double AngleOf(const Mat3& turn)
{
    const Vec3 sines{turn.m[5] - turn.m[7], turn.m[6] - turn.m[2], turn.m[1] - turn.m[3]};
    const double cosine = static_cast<double>(turn.m[0]) + turn.m[4] + turn.m[8] - 1.0;
    return std::atan2(Vec3Length(sines), cosine) * kRadiansToDegrees64;
}

Vec3 Across(const Vec3& direction, const Vec3& axis)
{
    return direction - axis * static_cast<float>(Vec3Dot(direction, axis));
}

std::string_view AxisName(const Vec3& axis)
{
    const bool minus = axis.x + axis.y + axis.z < 0.0f;
    const std::string_view name = axis.x != 0.0f ? "-X" : axis.y != 0.0f ? "-Y" : "-Z";
    return name.substr(minus ? 0 : 1);
}

Vec3 NearestAxis(const Vec3& direction)
{
    Vec3 nearest = kVec3UnitY;
    for (const Vec3& axis : {kVec3UnitX, kVec3UnitY, kVec3UnitZ, -kVec3UnitX, -kVec3UnitY, -kVec3UnitZ})
    {
        if (Vec3Dot(axis, direction) > Vec3Dot(nearest, direction))
            nearest = axis;
    }
    return nearest;
}

} // namespace gw
