#include "PointBone.h"

#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// If the cosine of the angle between two directions is below this, their sum is too short to determine the
// plane of the rotation.
constexpr double kOpposite = -0.99;

// Does the same as LeastSwing for unit vectors a and b, without computing the angle. With v = a x b and
// c = a . b, the rotation is c I + [v] + transpose(v) v / (1 + c), by Rodrigues' formula.
Mat3 SwingBetween(const Vec3& a, const Vec3& b)
{
    const double c = Vec3Dot(a, b);
    if (!(c > kOpposite))
        return LeastSwing(a, b);
    const Vec3 v = Vec3Cross(a, b);
    const auto cosine = static_cast<float>(c);
    const Vec3 w = v * static_cast<float>(1.0 / (1.0 + c));
    return {
        {cosine + v.x * w.x, v.x * w.y + v.z, v.x * w.z - v.y, v.y * w.x - v.z, cosine + v.y * w.y,
         v.y * w.z + v.x, v.z * w.x + v.y, v.z * w.y - v.x, cosine + v.z * w.z}
    };
}

Vec3 Unit(const Vec3& v)
{
    return v * static_cast<float>(1.0 / Vec3Length(v));
}

} // namespace

Mat3 PointedTo(const Vec3& direction, const Mat3& bone, const Vec3& jointBelow)
{
    return bone * SwingBetween(Vec3Normalized(Turned(jointBelow, bone)), Vec3Normalized(direction));
}

// Uses the law of cosines.
Vec3 MiddleJoint(const LegLengths& limb, const Vec3& end, const Vec3& side)
{
    const double distance = Vec3Length(end);
    const Vec3 line = Unit(end);
    const double square = limb.upper * limb.upper;
    const double along = (square - limb.lower * limb.lower + distance * distance) / (2.0 * distance);
    const double off = std::sqrt(std::max(square - along * along, 0.0));
    return line * static_cast<float>(along) + Unit(Across(side, line)) * static_cast<float>(off);
}

} // namespace gw
