// The parts of which a standing body is made: smooth curves by least squares, feet that hold and land, knees
// that yield.

#include "HoldFoot.h"
#include "Angles.h"
#include "CBandFit.h"
#include "Directions.h"
#include "LandFoot.h"
#include "SmoothCurve.h"
#include "StandSteps.h"
#include "YieldFoot.h"
#include "YieldKnee.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <numeric>
#include <tuple>

namespace gw {
namespace {

constexpr double kSeconds = 1.0 / 60.0;
constexpr double kLeg = 705.0;

// A least curve that is asked for two values bends nowhere, and one that is asked for steps climbs by them.
TEST(CBandFit, CurveIsTheStraightLineThroughTwoValuesOrAlongSteps)
{
    CBandFit values(101, 50.0, 0.0);
    values.AddValue(20, 1.0, 3.0);
    values.AddValue(70, 5.0, 13.0);
    CBandFit steps(101, 50.0, 0.0);
    steps.AddValue(20, 1.0, 3.0);
    for (size_t frame = 0; frame < 100; ++frame)
        steps.AddStep(frame, 2.0, 0.2);
    const std::vector<double> through = values.Solve();
    const std::vector<double> along = steps.Solve();
    for (size_t frame = 0; frame < 101; ++frame)
    {
        EXPECT_NEAR(through[frame], 0.2 * static_cast<double>(frame) - 1.0, 1e-6) << frame;
        EXPECT_NEAR(along[frame], 0.2 * static_cast<double>(frame) - 1.0, 1e-6) << frame;
    }
}

TEST(CBandFit, CurveKeepsHalfOfASwingAtItsFrequencyAndPassesOverWhatIsNoNumber)
{
    constexpr double kHertz = 2.0;
    const auto swing = [](size_t frame) {
        return std::sin(kTwoPi64 * kHertz * kSeconds * static_cast<double>(frame));
    };
    CBandFit fit(600, BendWeight(kHertz, kSeconds), 0.0);
    for (size_t frame = 0; frame < 600; ++frame)
        fit.AddValue(frame, 1.0, swing(frame));
    fit.AddValue(300, 1.0, std::numeric_limits<double>::quiet_NaN());
    fit.AddStep(300, 1.0, std::numeric_limits<double>::infinity());
    const std::vector<double> curve = fit.Solve();
    for (size_t frame = 200; frame < 400; ++frame)
        EXPECT_NEAR(curve[frame], 0.5 * swing(frame), 0.01) << frame;
}

// A foot in its plane: where its ankle is, how far its heel is up in degrees, and its length.
struct Foot
{
    std::vector<Vec3> free;
    std::vector<Vec3> toe;
    std::vector<Vec3> sourceAnkle;
    std::vector<Vec3> sourceToe;

    void Add(const Vec3& ankle, float heelUp, float strayed)
    {
        const float angle = (heelUp + 20.0f) * kDegreesToRadians;
        const Vec3 way{0.0f, -std::sin(angle), std::cos(angle)};
        sourceAnkle.push_back(ankle);
        sourceToe.push_back(ankle + way * 100.0f);
        toe.push_back(way * 144.0f);
        free.push_back(ankle + Vec3{0.0f, 0.0f, strayed});
    }
    // A foot that turns about y in place, on the middle of the source's foot.
    void AddTurned(float degrees, float length)
    {
        const float angle = degrees * kDegreesToRadians;
        const Vec3 way{std::sin(angle), 0.0f, std::cos(angle)};
        sourceAnkle.push_back(way * -50.0f);
        sourceToe.push_back(way * 50.0f);
        toe.push_back(way * length);
        free.push_back(kVec3Zero);
    }
    FootPaths Paths() const { return {toe, sourceAnkle, sourceToe, kLeg}; }
    StandingFoot Stand(const FootStands& stands) const { return StandSteps(Paths(), stands, kSeconds); }
    std::vector<Vec3> Hold(const std::vector<Contact>& contacts) const
    {
        return HoldFoot(free, Stand({contacts, {}, {}, {}}).steps, contacts, kSeconds);
    }
};

// On a foot of 144 instead of 100 the ankle goes 44 % farther; next to nothing of that is the toe's.
TEST(HoldFoot, LongerFootRollsOverItsToeWhereTheSourceDoes)
{
    Foot foot;
    for (int frame = 0; frame < 60; ++frame)
    {
        const float up = std::clamp(6.0f * static_cast<float>(frame - 40), 0.0f, 60.0f);
        const float angle = (up + 20.0f) * kDegreesToRadians;
        foot.Add({0.0f, 100.0f * std::sin(angle), -100.0f * std::cos(angle)}, up,
                 0.2f * static_cast<float>(frame));
    }
    const std::vector<Vec3> path = foot.Hold({{0, 60}});
    const float ahead = foot.toe[0].z - foot.toe[59].z;
    for (size_t frame = 1; frame < 60; ++frame)
        EXPECT_NEAR(path[frame].z + foot.toe[frame].z, path[0].z + foot.toe[0].z,
                    frame < 35 ? 0.1f : 0.1f * ahead)
            << frame;
    EXPECT_NEAR(path[59].z - path[0].z, ahead, 0.1f * ahead);
}

TEST(HoldFoot, FreePathIsLeftForAContactAloneAndWithoutACorner)
{
    Foot foot;
    for (int frame = 0; frame < 240; ++frame)
        foot.Add(kVec3Zero, 0.0f,
                 frame >= 100 && frame < 140 ? 0.5f * static_cast<float>(frame - 120) : 0.0f);
    const std::vector<Vec3> path = foot.Hold({{100, 140}});
    for (size_t frame = 101; frame < 140; ++frame)
        EXPECT_NEAR(path[frame].z, path[100].z, 0.05f) << frame;
    EXPECT_NEAR(path[100].z, 0.0f, 1.0f) << "in the middle of its free path";
    EXPECT_NEAR(path[70].z, 0.0f, 0.6f);
    EXPECT_NEAR(path[170].z, 0.0f, 0.6f);
}

TEST(HoldFoot, ShortDriftIsTakenAwayAndALongOneKept)
{
    // A sensor's drift and a dragged foot: the step in a frame, and how much of its way is kept.
    for (const auto& [step, least, most] : {std::tuple{0.05f, 0.0f, 0.1f}, {1.5f, 0.85f, 1.1f}})
    {
        SCOPED_TRACE(step);
        Foot foot;
        for (int frame = 0; frame < 120; ++frame)
            foot.Add({0.0f, 0.0f, step * static_cast<float>(frame)}, 0.0f, 0.0f);
        const std::vector<Vec3> path = foot.Hold({{0, 120}});
        const float kept = (path[119].z - path[0].z) / (119.0f * step);
        EXPECT_GE(kept, least);
        EXPECT_LE(kept, most);
    }
}

// The foot stands on its ankle, and its toe swings to where it stays. Before that is one frame of a stance
// elsewhere, which says nothing about how fast the ankle is.
TEST(HoldFoot, JumpBeforeAContactDoesNotMoveThePivot)
{
    Foot foot;
    foot.Add({0.0f, 0.0f, 700.0f}, 0.0f, 0.0f);
    for (int frame = 1; frame < 60; ++frame)
        foot.Add(kVec3Zero, std::max(60.0f - 10.0f * static_cast<float>(frame), 0.0f), 0.0f);
    const size_t jumps[] = {0};
    const Contact contacts[] = {{1, 60}};
    const std::vector<Vec3> path =
        HoldFoot(foot.free, foot.Stand({contacts, {}, {}, jumps}).steps, contacts, kSeconds);
    for (size_t frame = 2; frame < 60; ++frame)
        EXPECT_NEAR(path[frame].z, path[1].z, 6.0f) << frame;
}

// The ankle stays at first, because it is slower; the toe does all of the foot's surplus.
TEST(StandSteps, AnkleAndToeOfALongFootShareItsSlide)
{
    Foot foot;
    for (int frame = 0; frame < 60; ++frame)
    {
        foot.AddTurned(static_cast<float>(frame), 150.0f);
        foot.sourceAnkle.back() = foot.sourceAnkle.back() * 0.4f;
        foot.sourceToe.back() = foot.sourceToe.back() * 1.6f;
    }
    const Contact stand[] = {{0, 60}};
    const StandingFoot alone = foot.Stand({stand, {}, stand, {}});
    const StandingFoot shared = foot.Stand({stand, stand, stand, {}});
    EXPECT_LT(alone.toeSlides[0], 10.0) << "nobody minds how the ankle slides";
    EXPECT_GT(shared.ankleSlides[0], 15.0);
    EXPECT_NEAR(shared.ankleSlides[0], shared.toeSlides[0], 4.0);
}

TEST(YieldFoot, LongFootTurnsAFewDegreesLessAndSlidesLessAndAnEqualOneNotAtAll)
{
    const Contact stand[] = {{20, 80}};
    const FootStands stands{stand, stand, stand, {}};
    const std::vector<float> lifts(100, 0.0f);
    // the length of the target's foot, and the least and most degrees that it turns less
    for (const auto& [length, least, most] :
         {std::tuple{100.0f, 0.0, 0.1}, {120.0f, 8.0, 14.0}, {200.0f, 12.0, 17.2}})
    {
        SCOPED_TRACE(length);
        Foot foot;
        for (int frame = 0; frame < 100; ++frame)
            foot.AddTurned(std::clamp(1.5f * static_cast<float>(frame - 20), 0.0f, 90.0f), length);
        const std::vector<Mat3> turns = YieldFoot(foot.Paths(), stands, lifts, kSeconds);
        const double before = foot.Stand(stands).toeSlides[0];
        for (size_t frame = 0; frame < 100; ++frame)
            foot.toe[frame] = Turned(foot.toe[frame], turns[frame]);
        const double turned =
            std::atan2(foot.toe[79].x, foot.toe[79].z) - std::atan2(foot.toe[20].x, foot.toe[20].z);
        const double less = 88.5 - turned * kRadiansToDegrees64;
        EXPECT_GE(less, least);
        EXPECT_LE(less, most);
        EXPECT_LE(foot.Stand(stands).toeSlides[0], before + 0.01 - 0.7 * less);
        EXPECT_LE(Vec3Length(foot.toe[99] - Vec3{length, 0.0f, 0.0f}), 0.15f * length) << "it comes back";
    }
}

TEST(LandFoot, SoleIsOnTheFloorWhereItHasLandedAndHardlyBelowItElsewhere)
{
    std::vector<SoleWish> wishes(330, SoleWish{30.0f, 0.0f, 0.0f, 0.0f});
    for (size_t frame = 60; frame < 120; ++frame)
        wishes[frame].free = -40.0f;
    for (size_t frame = 170; frame < 210; ++frame)
        wishes[frame].landed = 1.0f;
    wishes[200].free = 90.0f;
    for (size_t frame = 250; frame < 290; ++frame)
        wishes[frame] = {30.0f, 0.0f, 1.0f, 45.0f};
    for (size_t frame = 290; frame < 330; ++frame)
        wishes[frame] = {60.0f, 0.0f, 1.0f, 45.0f};
    const std::vector<double> heights = LandFoot(wishes, kSeconds);
    EXPECT_NEAR(heights[10], 30.0, 1.0) << "on its free path";
    EXPECT_NEAR(heights[90], -40.0 / 16.0, 1.0) << "a sixteenth of a dip stays";
    EXPECT_NEAR(heights[190], 30.0 / 9.0, 1.5) << "nearly on the floor";
    EXPECT_NEAR(heights[197], 30.0 / 9.0, 5.0) << "not dragged by a glitch";
    EXPECT_NEAR(heights[270], 30.0 + 15.0 * 8.0 / 9.0, 1.5) << "nearly as high as it should be aloft";
    EXPECT_NEAR(heights[320], 60.0, 1.5) << "high enough already";
}

TEST(SmoothCurve, KeepsPlaceAndSumOfAPeakAndTheEndsOfALine)
{
    std::vector<float> peak(201, 0.0f);
    peak[100] = 10.0f;
    SmoothCurve(peak, 6.0);
    EXPECT_EQ(std::ranges::max_element(peak) - peak.begin(), 100);
    EXPECT_NEAR(std::accumulate(peak.begin(), peak.end(), 0.0), 10.0, 0.01);
    EXPECT_LT(peak[100], 2.5f);
    for (size_t frame = 1; frame <= 100; ++frame)
        EXPECT_NEAR(peak[100 - frame], peak[100 + frame], 1e-4) << frame;

    std::vector<float> level(50, 3.0f);
    SmoothCurve(level, 6.0);
    EXPECT_NEAR(level.front(), 3.0f, 1e-5f);
    EXPECT_NEAR(level.back(), 3.0f, 1e-5f);
}

// A knee that is nearly straight for ten frames, in which its direction turns over: it turns clearly
// slower, and a bent knee is left where it is.
TEST(SmoothCurve, SteadySidesSlowDownTheTurnOfANearlyStraightKnee)
{
    std::vector<Vec3> sides;
    sides.reserve(62);
    for (int frame = 0; frame < 60; ++frame)
        sides.push_back({std::clamp(static_cast<float>(frame - 30), -5.0f, 5.0f) * 4.0f, 0.0f, 5.0f});
    sides.push_back({0.0f, 360.0f, 0.0f});
    sides.push_back({std::numeric_limits<float>::quiet_NaN(), 0.0f, 0.0f});
    const auto fastest = [](const std::vector<Vec3>& of) {
        double turn = 0.0;
        for (size_t frame = 20; frame < 40; ++frame)
            turn = std::max(turn, AngleBetween(of[frame], of[frame + 1]));
        return turn;
    };
    const double before = fastest(sides);
    SteadySides(sides, 360.0, 8.0);
    EXPECT_LT(fastest(sides), 0.7 * before);
    EXPECT_EQ(sides[60], (Vec3{0.0f, 360.0f, 0.0f}));
    EXPECT_TRUE(std::isfinite(Vec3Length(sides[0])));
}

constexpr LegLengths kLegLengths{360.0, 345.0};
constexpr double kStiffness = 40.0;

// In radians.
double YieldedAngle(double asked, double kneeAngle)
{
    return 2.0 * std::asin(YieldingBend(kLegLengths, asked, std::sin(0.5 * kneeAngle), kStiffness));
}

TEST(YieldKnee, BentKneeReachesWhatIsAskedAndAStraightOneKeepsItsAngle)
{
    // degrees: of the knee; more: asked beyond the own reach; reached: of that, at the least; turned:
    // degrees, at most
    const std::tuple<const char*, double, double, double, double> rows[] = {
        {"bent, shorter", 60.0, -20.0, -18.0, 10.0},    {"bent, longer", 60.0, 20.0, 18.0, 10.0},
        {"straight, noise", 2.0, -0.3, 0.0, 1.0},       {"straight, longer", 2.0, 30.0, 0.0, 2.1},
        {"out of all reach", 90.0, 900.0, 150.0, 90.0},
    };
    for (const auto& [what, degrees, more, reached, turned] : rows)
    {
        SCOPED_TRACE(what);
        const double angle = degrees / 57.29578;
        const double own = ReachAt(kLegLengths, std::sin(0.5 * angle));
        const double yielded = YieldedAngle(own + more, angle);
        const double reach = ReachAt(kLegLengths, std::sin(0.5 * yielded));
        EXPECT_GE((reach - own) / more, reached / more);
        EXPECT_LE(std::fabs(reach - own), std::fabs(more) + 0.05);
        EXPECT_LE(std::fabs(yielded - angle) * 57.29578, turned);
        EXPECT_LE(reach, 705.0);
    }
}

TEST(YieldKnee, NoMillimetreTurnsAKneeFartherThanItsStiffnessLets)
{
    for (const double knee : {0.0, 0.0001, 0.001, 0.05, 0.3})
    {
        double before = YieldedAngle(640.0, knee);
        for (int step = 1; step < 180; ++step)
        {
            const double asked = 640.0 + 0.5 * step;
            const double angle = YieldedAngle(asked, knee);
            EXPECT_NEAR(angle, before, 0.5 / kStiffness + 0.001) << asked << " of a knee at " << knee;
            before = angle;
        }
    }
    EXPECT_NEAR(YieldedAngle(695.0, 0.0), YieldedAngle(695.0, 0.001), 0.002) << "whichever side of straight";
}

} // namespace
} // namespace gw
