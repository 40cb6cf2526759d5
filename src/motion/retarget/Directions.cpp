#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Any unit vector across a direction.
Vec3 AnyAcross(const Vec3& direction)
{
    const Vec3 axis = std::fabs(direction.x) < 0.5f ? kVec3UnitX : kVec3UnitY;
    return Vec3Normalized(Vec3Cross(direction, axis));
}

} // namespace

Vec3 ToWorld(const Vec3& direction, const Mat3& axes)
{
    return axes.Row(0) * direction.x + axes.Row(1) * direction.y + axes.Row(2) * direction.z;
}

Vec3 ToLocal(const Vec3& direction, const Mat3& axes)
{
    return {static_cast<float>(Vec3Dot(direction, axes.Row(0))),
            static_cast<float>(Vec3Dot(direction, axes.Row(1))),
            static_cast<float>(Vec3Dot(direction, axes.Row(2)))};
}

Mat3 SwingBetween(const Vec3& from, const Vec3& to)
{
    const Vec3 across = Vec3Cross(from, to);
    const double sine = Vec3Length(across);
    const double cosine = Vec3Dot(from, to);
    if (sine == 0.0 && cosine >= 0.0)
        return kMat3Identity;
    const Vec3 axis = sine == 0.0 ? AnyAcross(from) : across * static_cast<float>(1.0 / sine);
    return Mat3FromAxisAngle(axis, static_cast<float>(std::atan2(sine, cosine)));
}

} // namespace gw
