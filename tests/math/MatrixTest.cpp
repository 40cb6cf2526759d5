#include "Angles.h"
#include "Mat4.h"
#include "Rotations.h"

#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

const Mat4 kSkewed{{2, 1, 0, 0.5f, -1, 3, 1, 0, 0, 4, -2, 0.25f, 7, -8, 9, 1}};

} // namespace

TEST(Mat3, OutputsMayBeInputs)
{
    const Mat3 a = Mat3FromAxisAngle(kVec3UnitX, 0.3f);
    const Mat3 b = Mat3FromAxisAngle(kVec3UnitY, 0.7f);
    Mat3 left = a;
    EXPECT_EQ(&Mat3Multiply(left, b, left), &left);
    EXPECT_EQ(left, a * b);
    Mat3 right = b;
    Mat3Multiply(a, right, right);
    EXPECT_EQ(right, a * b);
    Vec3 v{1.0f, 2.0f, 3.0f};
    Vec3Sub(kVec3One, v, v);
    EXPECT_EQ(v, (Vec3{0.0f, -1.0f, -2.0f}));
}

TEST(Mat3, TheInverseIsGeneralAndNeverFails)
{
    const Mat3 skewed{{2, 1, 0, -1, 3, 1, 0, 4, -2}};
    const Mat3 product = skewed * Mat3InverseOrIdentity(skewed);
    ExpectNear(Mat4Compose(product, kVec3Zero), kMat4Identity, 1e-6);
    EXPECT_EQ(Mat3InverseOrIdentity({{1, 2, 3, 2, 4, 6, 0, 0, 1}}), kMat3Identity);
    EXPECT_EQ(Mat3InverseOrIdentity({{NAN, 0, 0, 0, 1, 0, 0, 0, 1}}), kMat3Identity);
}

TEST(Mat4, ComposeScalesThenTurnsThenMoves)
{
    const Mat3 quarter = Mat3FromAxisAngle(kVec3UnitZ, kHalfPi);
    const Vec3 move{10.0f, 20.0f, 30.0f};
    const Vec3 scale{2.0f, 3.0f, 4.0f};
    Mat4 m;
    Mat4Compose(m, &quarter, &move, &scale);
    ExpectNear(TransformCoord(kVec3One, m), {7, 22, 34}, 1e-6);
    EXPECT_NEAR(RowLengths(m).y, 3.0f, 1e-6);
    ExpectNear(Mat4Compose(NormalizedRows(m), kVec3Zero), Mat4Compose(quarter, kVec3Zero), 1e-5);
    Mat4Compose(m, nullptr, nullptr, nullptr);
    EXPECT_EQ(m, kMat4Identity);
    EXPECT_EQ(NormalizedRows(kMat4Zero), Mat3{}); // a row of length 0 is kept, without NaN
}

TEST(Mat4, ProductsActFromLeftToRightAndMayBeTheirOperands)
{
    const Mat4 turn = Mat4Compose(Mat3FromAxisAngle(kVec3UnitZ, kHalfPi), kVec3Zero);
    const Mat4 move = Mat4Compose(kMat3Identity, kVec3UnitX);
    ExpectNear(TransformCoord(kVec3UnitX, turn * move), {1, 1, 0}, 1e-6);
    Mat4 out = kSkewed;
    EXPECT_EQ(Mat4Multiply(&out, &out, &turn), &out);
    EXPECT_EQ(out, kSkewed * turn);
    out = kSkewed;
    EXPECT_EQ(Mat4Multiply(&out, &turn, &out), &out);
    EXPECT_EQ(out, turn * kSkewed);
    EXPECT_EQ(Mat4Multiply(&out, nullptr, &turn), nullptr);
    EXPECT_EQ(out, turn * kSkewed);
    EXPECT_EQ(AxisSwapForward * AxisSwapBack, kMat4Identity);
}

TEST(Mat4, TheInverseIsGeneralAndLeavesItsOutputWhereItFails)
{
    Mat4 inverse = kSkewed;
    float determinant = 0.0f;
    EXPECT_EQ(Mat4Inverse(&inverse, &determinant, &inverse), &inverse);
    ExpectNear(kSkewed * inverse, kMat4Identity, 1e-5);
    ExpectNear(inverse * kSkewed, kMat4Identity, 1e-5);
    EXPECT_NE(determinant, 0.0f);

    Mat4 tiny = kMat4Identity; // its determinant is not 0, but has no finite reciprocal in 32 bits
    tiny.m[0] = 1e-20f;
    tiny.m[5] = 1e-20f;
    for (const Mat4& singular : {kMat4Zero, tiny})
    {
        Mat4 out = kSkewed;
        determinant = 99.0f;
        EXPECT_EQ(Mat4Inverse(&out, &determinant, &singular), nullptr);
        EXPECT_EQ(out, kSkewed);
        EXPECT_LT(determinant, 1.0f);
        EXPECT_EQ(Mat4InverseOrIdentity(singular), kMat4Identity);
    }
}

TEST(Mat4, CoordinatesAreDividedUnlessTheFourthIsOne)
{
    const std::tuple<const char*, float, float> rows[] = {
        {"one", 1.0f, 3.0f},      {"one within the tolerance, its end included", 1.0f + kEpsilon, 3.0f},
        {"two", 2.0f, 1.5f},      {"negative", -1.0f, -3.0f},
        {"zero", 0.0f, INFINITY},
    };
    for (const auto& [what, w, x] : rows)
    {
        Mat4 m = kMat4Identity;
        m.m[15] = w;
        Vec3 v{3.0f, 0.0f, 0.0f};
        EXPECT_EQ(TransformCoord(&v, &v, &m), &v);
        EXPECT_EQ(v.x, x) << what;
    }
    Vec3 v = kVec3One;
    EXPECT_EQ(TransformCoord(&v, &v, nullptr), nullptr);
    EXPECT_EQ(v, kVec3One);
}

} // namespace gw
