#include "Rotations.h"

#include "Angles.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace gw {
namespace {

// Uses distances instead of dot products: an arc cosine near 1 loses half of the digits.
double SquaredDistance(const float* a, const float* b, int count, float sign)
{
    double sum = 0.0;
    for (int i = 0; i < count; ++i)
    {
        const double difference = static_cast<double>(a[i]) - sign * b[i];
        sum += difference * difference;
    }
    return sum;
}

double Degrees(double radians)
{
    return radians * kRadiansToDegrees64;
}

void ExpectNear(const float* found, const float* expected, int count, double tolerance)
{
    for (int i = 0; i < count; ++i)
        EXPECT_NEAR(found[i], expected[i], tolerance) << "element " << i;
}

} // namespace

double DegreesBetween(const Mat3& a, const Mat3& b)
{
    return Degrees(2.0 * std::asin(std::min(std::sqrt(SquaredDistance(a.m, b.m, 9, 1.0f) / 8.0), 1.0)));
}

double DegreesBetween(const Quat& a, const Quat& b)
{
    const float p[] = {a.w, a.x, a.y, a.z};
    const float q[] = {b.w, b.x, b.y, b.z};
    const double distance = std::min(SquaredDistance(p, q, 4, 1.0f), SquaredDistance(p, q, 4, -1.0f));
    return Degrees(4.0 * std::asin(std::min(std::sqrt(distance) / 2.0, 1.0)));
}

void ExpectNear(const Vec3& found, const Vec3& expected, double tolerance)
{
    ExpectNear(&found.x, &expected.x, 3, tolerance);
}

void ExpectNear(const Mat4& found, const Mat4& expected, double tolerance)
{
    ExpectNear(found.m, expected.m, 16, tolerance);
}

} // namespace gw
