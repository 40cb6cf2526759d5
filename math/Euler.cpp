// Conversion between rotation matrices and Euler angles.
//
// Every order comes down to the same three steps: one matrix element is the sine of the middle angle, and the
// two outer angles are the arc tangents of two pairs of elements. When the middle angle is a quarter turn
// (gimbal lock), the outer two turn about the same axis and only their sum or difference is defined, so one
// is set to 0 and the other takes the whole rotation.
//
// The orders do not agree on details: which angle becomes 0, when the lock is detected, where a sign falls
// for an element of exactly 0, and SafeAsin swaps its ends. Files depend on these differences byte for byte,
// so the code keeps one function or table row per variant instead of one formula for all.

#include "Euler.h"

#include "Angles.h"

#include <array>
#include <cmath>

namespace gw {

namespace {

struct OrderRow
{
    std::string_view name;
    std::array<int, 3> product; // axes of the product from left to right, 0 for X
};

constexpr OrderRow kOrders[] = {
    {"ZYX", {0, 1, 2}},
    {"YZX", {0, 2, 1}},
    {"ZXY", {1, 0, 2}},
    {"XZY", {1, 2, 0}},
    {"XYZ", {2, 1, 0}},
    {"YXZ", {2, 0, 1}},
};

// Orders 0 to 3 share one scheme, written as a table of matrix elements with signs. The middle angle is an
// arc sine. When it is a quarter turn, `gimbal` is the angle of the gimbal axis, and the angle of the zero
// axis is 0.
struct Element
{
    int index;
    float sign;
    float Of(const float* m) const { return sign * m[index]; }
};
struct Arc
{
    Element sine;
    Element cosine;
    float Of(const float* m) const { return std::atan2(sine.Of(m), cosine.Of(m)); }
};
struct SineScheme
{
    Element middle;
    int middleAxis;
    int gimbalAxis;
    Arc gimbal;
    int zeroAxis;
    Arc gimbalRegular; // the gimbal axis in the regular case
    Arc zeroRegular;   // the zero axis in the regular case
};

constexpr SineScheme kSchemes[] = {
    {{6, 1},  1, 0, {{1, 1}, {4, 1}},  2, {{7, -1}, {8, 1}}, {{3, -1}, {0, 1}}},
    {{2, -1}, 1, 2, {{3, -1}, {6, 1}}, 0, {{1, 1}, {0, 1}},  {{5, 1}, {8, 1}} },
    {{3, -1}, 2, 0, {{2, -1}, {8, 1}}, 1, {{5, 1}, {4, 1}},  {{6, 1}, {0, 1}} },
    {{1, 1},  2, 1, {{5, 1}, {8, 1}},  0, {{2, -1}, {0, 1}}, {{7, -1}, {4, 1}}},
};

void DecomposeBySine(const SineScheme& scheme, const float* m, float* angles)
{
    const float middle = static_cast<float>(SafeAsin(scheme.middle.Of(m)));
    angles[scheme.middleAxis] = middle;
    if (middle >= kHalfPi || middle <= -kHalfPi)
    {
        const float arc = scheme.gimbal.Of(m);
        angles[scheme.zeroAxis] = 0.0f;
        angles[scheme.gimbalAxis] = middle > 0.0f ? arc : -arc;
        return;
    }
    angles[scheme.gimbalAxis] = scheme.gimbalRegular.Of(m);
    angles[scheme.zeroAxis] = scheme.zeroRegular.Of(m);
}

bool IsNearHalfPi(double angle)
{
    return std::fabs(std::fabs(angle) - kHalfPi64) < static_cast<double>(kEpsilon);
}

// "ZXY": element 5 is the sine of X. X is computed last, from a derived cosine.
void DecomposeZXY(const float* m, float* angles)
{
    if (1.0f - std::fabs(m[5]) < kEpsilon)
    {
        angles[0] = m[5] > 0.0f ? kHalfPi : -kHalfPi;
        angles[1] = 0.0f;
        angles[2] = std::atan2(m[1], m[0]);
        return;
    }
    const double z = -std::atan2(static_cast<double>(m[3]), static_cast<double>(m[4]));
    const double cosine = IsNearHalfPi(z) ? -(m[3] / std::sin(z)) : m[4] / std::cos(z);
    angles[0] = static_cast<float>(std::atan2(static_cast<double>(m[5]), cosine));
    angles[1] = -std::atan2(m[2], m[8]);
    angles[2] = static_cast<float>(z);
}

// "YXZ": element 7 is the negative sine of X. For an element of exactly 0, the sign falls on the other side
// than in DecomposeZXY.
void DecomposeYXZ(const float* m, float* angles)
{
    if (1.0f - std::fabs(m[7]) < kEpsilon)
    {
        angles[0] = m[7] >= 0.0f ? -kHalfPi : kHalfPi;
        angles[1] = 0.0f;
        angles[2] = -std::atan2(m[3], m[0]);
        return;
    }
    const double z = std::atan2(static_cast<double>(m[1]), static_cast<double>(m[4]));
    const double cosine = IsNearHalfPi(z) ? m[1] / std::sin(z) : m[4] / std::cos(z);
    angles[0] = static_cast<float>(std::atan2(static_cast<double>(-m[7]), cosine));
    angles[1] = std::atan2(m[6], m[8]);
    angles[2] = static_cast<float>(z);
}

double QuotientAngle(float numerator, float denominator)
{
    if (numerator == 0.0f && denominator == 0.0f)
        return 0.0;
    return std::atan(static_cast<double>(numerator) / denominator);
}

// An arc sine lies within a quarter turn, so its cosine is never negative and cannot flip a sign; only the
// other factor matters. For a NaN, nothing is flipped.
double InHalfTurn(double angle, float denominator, double y)
{
    return denominator < 0.0f && !std::isnan(y) ? angle + kPi64 : angle;
}

// Decomposes "ZYX" from the only five elements it needs: row 0 and the last elements of rows 1 and 2.
Vec3 EulerDegreesOf(const Vec3& row0, float m5, float m8)
{
    const double y = SafeAsin(-row0.z);
    const double x = InHalfTurn(QuotientAngle(m5, m8), m8, y);
    const double z = InHalfTurn(QuotientAngle(row0.y, row0.x), row0.x, y);
    const double degrees = kInversePi64 * 180.0;
    return {static_cast<float>(x * degrees), static_cast<float>(y * degrees),
            static_cast<float>(z * degrees)};
}

} // namespace

Mat3 EulerToMat3(std::string_view order, const Vec3& degrees)
{
    for (const OrderRow& row : kOrders)
    {
        if (row.name != order)
            continue;
        const Mat3 about[3] = {Mat3FromAxisAngle(kVec3UnitX, degrees.x * kDegreesToRadians),
                               Mat3FromAxisAngle(kVec3UnitY, degrees.y * kDegreesToRadians),
                               Mat3FromAxisAngle(kVec3UnitZ, degrees.z * kDegreesToRadians)};
        return about[row.product[0]] * about[row.product[1]] * about[row.product[2]];
    }
    return kMat3Identity;
}

void Mat3ToEuler(const Mat3& m, int order, float& x, float& y, float& z)
{
    if (order < 0 || order > static_cast<int>(EEulerOrder::YXZ))
        return;
    float angles[3];
    if (order == static_cast<int>(EEulerOrder::ZXY))
        DecomposeZXY(m.m, angles);
    else if (order == static_cast<int>(EEulerOrder::YXZ))
        DecomposeYXZ(m.m, angles);
    else
        DecomposeBySine(kSchemes[order], m.m, angles);
    x = angles[0];
    y = angles[1];
    z = angles[2];
}

Vec3 Mat3ToEulerDegrees(const Mat3& matrix)
{
    return EulerDegreesOf(matrix.Row(0), matrix.m[5], matrix.m[8]);
}

Vec3 RowsToEulerDegrees(const Mat4& m, double rowLength0)
{
    const auto lastOf = [&m](int row) { return Vec3Normalized(m.Row(row)).z; };
    return EulerDegreesOf(Vec3DividedBy(m.Row(0), rowLength0), lastOf(1), lastOf(2));
}

void Mat3ToEulerDegrees(const Mat3& m, float& x, float& y, float& z)
{
    const Vec3 angles = Mat3ToEulerDegrees(m);
    x = angles.x;
    y = angles.y;
    z = angles.z;
}

Vec3 EulerDegreesZYX(const Mat3& m)
{
    const float* e = m.m;
    const double z = std::atan2(static_cast<double>(e[1]), static_cast<double>(e[0]));
    const double y = std::atan2(-static_cast<double>(e[2]), std::hypot(e[0], e[1]));
    // After rotating back by z, these two rows contain a rotation about X only.
    const double c = std::cos(z);
    const double s = std::sin(z);
    const double x = std::atan2(e[6] * s - e[7] * c, e[4] * c - e[3] * s);
    const double factor = kRadiansToDegrees64;
    return {static_cast<float>(x * factor), static_cast<float>(y * factor), static_cast<float>(z * factor)};
}

Mat3 UpAxisMatrix(char letter)
{
    switch (letter)
    {
    case 'X':
        return Mat3FromAxisAngle(kVec3UnitZ, -kHalfPi);
    case 'Z':
        return Mat3FromAxisAngle(kVec3UnitX, kHalfPi);
    default:
        return kMat3Identity;
    }
}

} // namespace gw
