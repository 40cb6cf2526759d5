#include "CLegSolver.h"
#include "Rotations.h"

#include <gtest/gtest.h>
#include <random>
#include <tuple>

namespace gw {
namespace {

constexpr float kUpper = 360.0f;
constexpr float kLower = 345.0f;

struct Solved
{
    bool ok;
    Vec3 knee;
    Vec3 ankle;
    CLegSolver::Pose pose;
};

constexpr Vec3 kStraight{0, kLower, 0};
constexpr Vec3 kAskew{40, 330, -25}; // an ankle beside and behind the shin

// Solves one leg for a goal in the solver's frame and rebuilds where knee and ankle come to stand.
Solved Reach(const Vec3& goal, Vec3 hint, const Vec3& lower = kStraight)
{
    CLegSolver solver(1);
    solver.SetLimb(0, {0, kUpper, 0}, lower, kVec3UnitZ, kVec3UnitX);
    Mat4 matrix = kMat4Identity;
    matrix.SetTranslation(goal);
    Solved out{};
    out.ok = solver.Solve(0, hint, matrix, out.pose);
    const Mat4 hip = Mat4Compose(out.pose.hip, kVec3Zero);
    out.knee = TransformCoord({0, 0, -kUpper}, hip);
    const Vec3 shank =
        TransformCoord(TransformCoord(lower, AxisSwapForward), Mat4Compose(out.pose.knee, kVec3Zero));
    out.ankle = TransformCoord(shank + Vec3{0, 0, -kUpper}, hip);
    return out;
}

Vec3 AcrossGoal(const Vec3& point, const Vec3& goal)
{
    const Vec3 n = Vec3Normalized(goal);
    return Vec3Normalized(point - n * static_cast<float>(Vec3Dot(point, n)));
}

bool IsRotation(const Mat3& m)
{
    return DegreesBetween(m * Mat3Transpose(m), kMat3Identity) < 0.01 &&
           Vec3Dot(Vec3Cross(m.Row(0), m.Row(1)), m.Row(2)) > 0.0;
}

TEST(CLegSolver, ReachesRandomGoalsWithTheKneeTowardTheHint)
{
    std::mt19937 random(7);
    std::uniform_real_distribution<float> unit(-1.0f, 1.0f);
    int solved = 0;
    while (solved < 300)
    {
        const Vec3 goal = Vec3{unit(random), unit(random), unit(random)} * (kUpper + kLower);
        const Vec3 hint = Vec3{unit(random), unit(random), unit(random)} * 800.0f;
        const double distance = Vec3Length(goal);
        if (distance > 0.98 * (kUpper + kLower) || distance < 80.0)
            continue;
        const Vec3 lower = ++solved % 2 ? kStraight : kAskew;
        SCOPED_TRACE(testing::Message() << goal.x << ' ' << goal.y << ' ' << goal.z);
        const Solved leg = Reach(goal, hint, lower);
        ASSERT_TRUE(leg.ok);
        EXPECT_LT(Vec3Length(leg.ankle - goal), 0.05);
        EXPECT_NEAR(Vec3Length(leg.knee), kUpper, 0.05);
        EXPECT_NEAR(Vec3Length(leg.ankle - leg.knee), Vec3Length(lower), 0.05);
        EXPECT_TRUE(IsRotation(leg.pose.hip));
        EXPECT_TRUE(IsRotation(leg.pose.foot));
        if (Vec3Length(AcrossGoal(leg.knee, goal)) > 0.0)
        {
            EXPECT_GT(Vec3Dot(AcrossGoal(leg.knee, goal), AcrossGoal(hint, goal)), 0.999);
        }
    }
}

TEST(CLegSolver, GoalsAtTheLimits)
{
    const float full = kUpper + kLower;
    Vec3 atReach = {full, 0, 0};
    EXPECT_FALSE(CLimbChain::ClampGoal({0, kUpper, 0}, {0, 0, kLower}, atReach));
    EXPECT_EQ(atReach, (Vec3{full, 0, 0}));
    // reach: how far from the hip the ankle comes to stand
    const std::tuple<const char*, Vec3, bool, double> rows[] = {
        {"far out of reach is drawn in to just short of straight", {0, 0, -2000}, true, full / 1.00001},
        {"exactly at the full length", {0, 0, -full}, true, full},
        {"exactly at the full length, sideways", {full, 0, 0}, true, full},
        {"straight along the hinge's axis", {0, 0, 500}, true, 500},
        {"nearer than the segments can fold", {0, 0, -10}, false, 0},
        {"hardly nearer than that", {0, 0, -14.9f}, false, 0},
        {"at the hip itself", {0, 0, 0}, false, 0},
    };
    for (const auto& [what, goal, ok, reach] : rows)
    {
        SCOPED_TRACE(what);
        const Solved leg = Reach(goal, {500, 100, -300});
        EXPECT_EQ(leg.ok, ok);
        if (!ok || !leg.ok)
            continue;
        EXPECT_TRUE(IsRotation(leg.pose.hip));
        EXPECT_NEAR(Vec3Length(leg.ankle), reach, 0.002);
        EXPECT_LT(Vec3Length(leg.ankle - Vec3Normalized(goal) * static_cast<float>(reach)), 0.05);
    }
}

} // namespace
} // namespace gw
