#include "Angles.h"
#include "Euler.h"
#include "Quat.h"
#include "Rotations.h"

#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <tuple>

namespace gw {
namespace {

constexpr double kRoundingDegrees = 1e-4;
constexpr const char* kOrderNames[] = {"XYZ", "ZYX", "XZY", "YZX", "ZXY", "YXZ"}; // by code

Vec3 ToEulerDegrees(const Mat3& m, int order)
{
    Vec3 radians{-99.0f, -99.0f, -99.0f};
    Mat3ToEuler(m, order, radians.x, radians.y, radians.z);
    return radians * kRadiansToDegrees;
}

Mat3 About(char axis, float degrees)
{
    const Vec3 unit{axis == 'X' ? 1.0f : 0.0f, axis == 'Y' ? 1.0f : 0.0f, axis == 'Z' ? 1.0f : 0.0f};
    return Mat3FromAxisAngle(unit, degrees * kDegreesToRadians);
}

} // namespace

TEST(Euler, TheLastLetterOfAnOrderActsFirst)
{
    const Vec3 degrees{20.0f, -50.0f, 70.0f};
    const std::map<char, Mat3> about = {
        {'X', About('X', degrees.x)}, {'Y', About('Y', degrees.y)}, {'Z', About('Z', degrees.z)}};
    for (const std::string order : kOrderNames)
    {
        const Mat3 expected = about.at(order[2]) * about.at(order[1]) * about.at(order[0]);
        EXPECT_LT(DegreesBetween(EulerToMat3(order, degrees), expected), kRoundingDegrees) << order;
    }
    for (const char* none : {"xyz", "", "XYZZ", "XXY"})
        EXPECT_EQ(EulerToMat3(none, {10.0f, 20.0f, 30.0f}), kMat3Identity) << none;
}

TEST(Euler, AnglesComeBackInAllOrders)
{
    const float angles[] = {-89.0f, -60.0f, -30.0f, 0.0f, 30.0f, 60.0f, 89.0f};
    for (int order = 0; order < 6; ++order)
    {
        for (int i = 0; i < 7 * 7 * 7; ++i)
        {
            const Vec3 degrees{angles[i / 49], angles[i / 7 % 7], angles[i % 7]};
            ExpectNear(ToEulerDegrees(EulerToMat3(kOrderNames[order], degrees), order), degrees, 2e-3);
        }
    }
    for (const int order : {-1, 6})
        ExpectNear(ToEulerDegrees(About('X', 20.0f), order), Vec3{-99.0f, -99.0f, -99.0f} * kRadiansToDegrees,
                   0.0);
}

// For a quarter turn of the middle angle, codes 0 to 3 return it with the opposite sign, codes 4 and 5 with
// its own.
TEST(Euler, QuarterTurnsOfTheMiddleAngle)
{
    // axes: of the two rotations from left to right
    const std::tuple<const char*, const char*, int, float, float, Vec3> rows[] = {
        {"XYZ up", "YX", 0, 90.0f, 30.0f, {-30.0f, -90.0f, 0.0f}},
        {"XYZ down", "YX", 0, -90.0f, 30.0f, {-30.0f, 90.0f, 0.0f}},
        {"ZYX up", "YZ", 1, 90.0f, 30.0f, {0.0f, -90.0f, -30.0f}},
        {"ZYX down", "YZ", 1, -90.0f, 30.0f, {0.0f, 90.0f, 150.0f}},
        {"XZY up", "ZX", 2, 90.0f, 30.0f, {30.0f, 0.0f, -90.0f}},
        {"XZY down", "ZX", 2, -90.0f, 30.0f, {30.0f, 0.0f, 90.0f}},
        {"YZX up", "ZY", 3, 90.0f, 30.0f, {0.0f, -30.0f, -90.0f}},
        {"YZX down", "ZY", 3, -90.0f, 30.0f, {0.0f, -30.0f, 90.0f}},
        {"ZXY up", "XZ", 4, 90.0f, 30.0f, {90.0f, 0.0f, 30.0f}},
        {"ZXY down", "XZ", 4, -90.0f, 30.0f, {-90.0f, 0.0f, 30.0f}},
        {"YXZ up", "ZX", 5, 30.0f, 90.0f, {90.0f, 0.0f, 30.0f}},
        {"YXZ down", "ZX", 5, 30.0f, -90.0f, {-90.0f, 0.0f, 30.0f}},
    };
    for (const auto& [what, axes, order, first, second, degrees] : rows)
    {
        SCOPED_TRACE(what);
        const Mat3 m = About(axes[0], first) * About(axes[1], second);
        ExpectNear(ToEulerDegrees(m, order), degrees, 1e-3);
    }
    // A quarter turn of the angle from which X is derived, exact to the last bit.
    const Mat3 quarter = Mat3FromAxisAngle(kVec3UnitZ, kHalfPi);
    ExpectNear(ToEulerDegrees(About('Y', 30.0f) * About('X', 20.0f) * quarter, 4), {20.0f, 30.0f, 90.0f},
               1e-3);
    ExpectNear(ToEulerDegrees(quarter * About('X', 20.0f) * About('Y', 30.0f), 5), {20.0f, 30.0f, 90.0f},
               1e-3);
}

TEST(Euler, DegreesRebuildAWholeTurnAndAreNeverNaN)
{
    for (int i = 0; i < 13 * 9 * 13; ++i)
    {
        const auto step = [i](int divisor, int count) { return static_cast<float>(i / divisor % count); };
        const Vec3 degrees{step(1, 13) * 30.0f - 180.0f, step(13, 9) * 22.0f - 88.0f,
                           step(13 * 9, 13) * 30.0f - 180.0f};
        const Mat3 m = EulerToMat3("ZYX", degrees);
        const Vec3 angles = Mat3ToEulerDegrees(m);
        ASSERT_LT(DegreesBetween(EulerToMat3("ZYX", angles), m), 1e-3) << degrees.x << ' ' << degrees.y;
        const Mat4 scaled = Mat4Compose(m, kVec3One, {2.0f, 0.7f, 3.1f});
        ASSERT_EQ(RowsToEulerDegrees(scaled, Vec3Length(scaled.Row(0))),
                  Mat3ToEulerDegrees(NormalizedRows(scaled)));
    }
    ExpectNear(Mat3ToEulerDegrees(About('X', -100.0f)), {260.0f, 0.0f, 0.0f}, 1e-3);
    const Mat3 upright{{0, 0, -1, 0, 1, 0, 1, 0, 0}}; // a quotient of 0 by 0, with the sine at its end
    ExpectNear(Mat3ToEulerDegrees(upright), {0.0f, -90.0f, 0.0f}, 1e-3);
}

TEST(Euler, UpAxesTurnOntoTheSceneAxis)
{
    EXPECT_LT(DegreesBetween(UpAxisMatrix('X'), About('Z', -90.0f)), kRoundingDegrees);
    EXPECT_LT(DegreesBetween(UpAxisMatrix('Z'), About('X', 90.0f)), kRoundingDegrees);
    EXPECT_EQ(UpAxisMatrix('Y'), kMat3Identity);
    EXPECT_EQ(UpAxisMatrix('x'), kMat3Identity);
}

TEST(Angles, TheEndsOfTheArcSineAreTheOtherWayRound)
{
    for (const float x : {1.0f, 1.5f})
    {
        EXPECT_EQ(SafeAsin(x), -kHalfPi64);
        EXPECT_EQ(SafeAsin(-x), kHalfPi64);
        EXPECT_EQ(SafeAcos(x), 0.0);
        EXPECT_EQ(SafeAcos(-x), kPi64);
    }
    EXPECT_GT(SafeAsin(std::nextafter(1.0f, 0.0f)), 1.57);
}

TEST(Quat, MatricesComeBackAlsoFromHalfTurns)
{
    const float r = std::sqrt(0.5f);
    const float s = std::sqrt(1.0f / 3.0f);
    // For the last one, only the largest element yields all digits.
    const Vec3 axes[] = {
        {1.0f, 0.0f, 0.0f}, {0.0f, 1.0f, 0.0f}, {0.0f, 0.0f, 1.0f}, {r, r, 0.0f},
        {0.0f, -r, r},      {r, 0.0f, -r},      {s, s, -s},         {0.0f, 0.9999995f, 0.001f},
    };
    for (const Vec3& axis : axes)
    {
        for (const float degrees : {0.0f, 1.0f, 90.0f, 119.9f, 120.1f, 179.99f, 180.0f, 181.0f, 270.0f})
        {
            const Mat3 m = Mat3FromAxisAngle(axis, degrees * kDegreesToRadians);
            const Quat q = QuatFromMat3(m);
            const double half = static_cast<double>(degrees) / 2.0 * kDegreesToRadians64;
            const auto sine = static_cast<float>(std::sin(half));
            const Quat expected{static_cast<float>(std::cos(half)), axis.x * sine, axis.y * sine,
                                axis.z * sine};
            ASSERT_LT(DegreesBetween(q, expected), 1e-3) << degrees << " about " << axis.x << ' ' << axis.y;
            ASSERT_LT(DegreesBetween(QuatToMat3(q), m), 1e-3);
        }
    }
    EXPECT_EQ(QuatFromMat3(kMat3Identity), kQuatIdentity);
    EXPECT_EQ(QuatToMat3(kQuatIdentity), kMat3Identity);
    const Mat3 halfTurn{{1, 0, 0, 0, -1, 0, 0, 0, -1}};
    EXPECT_EQ(QuatFromMat3(halfTurn), (Quat{0.0f, 1.0f, 0.0f, 0.0f}));
}

TEST(Quat, SlerpGoesTheShortWayAtAnEvenPace)
{
    const Quat a = QuatFromMat3(About('Y', 20.0f));
    const Quat b = QuatFromMat3(About('Y', 140.0f));
    Quat minusB;
    QuatScale(b, -1.0f, minusB);
    for (const float t : {-0.5f, 0.0f, 0.25f, 1.0f, 1.5f}) // not clamped
    {
        const Quat expected = QuatFromMat3(About('Y', 20.0f + 120.0f * t));
        EXPECT_LT(DegreesBetween(QuatSlerp(t, a, b), expected), kRoundingDegrees) << t;
        EXPECT_LT(DegreesBetween(QuatSlerp(t, a, minusB), expected), kRoundingDegrees) << t;
        Quat minusA;
        QuatScale(a, -1.0f, minusA);
        const Quat same = QuatSlerp(t, a, minusA);
        // the quaternion itself, not its negative
        EXPECT_LT(std::fabs(same.w - a.w) + std::fabs(same.y - a.y), 1e-6f) << t;
    }
    Quat out = a;
    QuatSlerp(out, 0.5f, out, b);
    EXPECT_EQ(out, QuatSlerp(0.5f, a, b));
}

} // namespace gw
