// Converts a rotation to the numbers of a bone map row: axis codes (24 signed permutations) and three whole
// degrees. The codes that leave the smallest angles are chosen first. Rounding to degrees loses up to half a
// degree per axis, so all 27 neighbors of the rounded angles are compared, weighing the bone's direction far
// more than its twist.

#include "BoneOffset.h"

#include "Angles.h"
#include "CPoseMatcher.h"
#include "Directions.h"
#include "Euler.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>
#include <vector>

namespace gw {

namespace {

// The weight of one degree of twist relative to one degree of direction.
constexpr double kTwistWeight = 0.1;

// Returns all signed permutations that are rotations, identity first.
std::vector<AxisCodes> AxisRotations()
{
    std::vector<AxisCodes> rotations;
    for (const AxisCodes& order : std::initializer_list<AxisCodes>{
             {1, 2, 3},
             {2, 3, 1},
             {3, 1, 2},
             {1, 3, 2},
             {2, 1, 3},
             {3, 2, 1}
    })
    {
        for (int signs = 0; signs < 8; ++signs)
        {
            const auto signedBy = [&](int bit) { return (signs >> bit) & 1 ? -1 : 1; };
            const AxisCodes codes{order[0] * signedBy(0), order[1] * signedBy(1), order[2] * signedBy(2)};
            const Mat3 matrix = AxisMatrix(codes);
            if (Vec3Dot(Vec3Cross(matrix.Row(0), matrix.Row(1)), matrix.Row(2)) > 0.0)
                rotations.push_back(codes);
        }
    }
    return rotations;
}

using Degrees = std::array<float, 3>;

// Returns the remaining angles of a rotation after its axis codes.
Degrees AnglesBehind(const AxisCodes& codes, const Mat3& rotation)
{
    Degrees angles{};
    Mat3ToEuler(Mat3Transpose(AxisMatrix(codes)) * rotation, static_cast<int>(EEulerOrder::ZYX), angles[0],
                angles[1], angles[2]);
    for (float& angle : angles)
        angle /= kDegreesToRadians;
    return angles;
}

float Size(const Degrees& angles)
{
    return std::fabs(angles[0]) + std::fabs(angles[1]) + std::fabs(angles[2]);
}

// Returns the difference between the numbers and a rotation in degrees: `axis` counts fully, other directions
// only a little.
double Distance(const RowNumbers& numbers, const Mat3& rotation, const Vec3& axis)
{
    const Mat3 offset = OffsetOf(numbers);
    double twist = 0.0;
    for (int row = 0; row < 3; ++row)
        twist = std::max(twist, AngleBetween(offset.Row(row), rotation.Row(row)));
    return AngleBetween(Turned(axis, offset), Turned(axis, rotation)) + kTwistWeight * twist;
}

} // namespace

Mat3 OffsetOf(const RowNumbers& numbers)
{
    const auto& [x, y, z] = numbers.rotation;
    return OffsetRotation({static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)},
                          AxisMatrix(numbers.axes));
}

RowNumbers NearestOffset(const Mat3& rotation, const Vec3& axis)
{
    static const std::vector<AxisCodes> kRotations = AxisRotations();
    const auto size = [&](const AxisCodes& codes) { return std::round(Size(AnglesBehind(codes, rotation))); };
    const AxisCodes codes = *std::ranges::min_element(kRotations, {}, size);
    const Degrees angles = AnglesBehind(codes, rotation);
    RowNumbers best;
    double least = 360.0;
    for (int step = 0; step < 27; ++step)
    {
        const std::array<int, 3> steps{step % 3 - 1, step / 3 % 3 - 1, step / 9 - 1};
        RowNumbers numbers{{}, codes};
        for (size_t i = 0; i < steps.size(); ++i)
            numbers.rotation[i] = static_cast<int>(std::lround(angles[i])) + steps[i];
        const double distance = Distance(numbers, rotation, axis);
        if (distance < least)
        {
            least = distance;
            best = numbers;
        }
    }
    return best;
}

} // namespace gw
