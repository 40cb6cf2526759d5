// The parts of which a standing body is made: holds, smooth curves, knees that yield.

#include "HoldFoot.h"
#include "SmoothCurve.h"
#include "YieldKnee.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <numeric>
#include <tuple>

namespace gw {
namespace {

constexpr double kPlay = 15.0;
constexpr double kFade = 4.0;

// A foot that goes forward by so much a frame.
std::vector<Vec3> Drift(int frameCount, float step)
{
    std::vector<Vec3> path;
    for (int frame = 0; frame < frameCount; ++frame)
        path.push_back({0.0f, 80.0f, step * static_cast<float>(frame)});
    return path;
}

std::vector<FootHold> Hold(const std::vector<Vec3>& path, const std::vector<Contact>& contacts)
{
    return HoldFoot({path, path, 1.0}, contacts, kPlay, kFade);
}

TEST(HoldFoot, HoldsInTheMiddleAndFadesAtTheEnds)
{
    const std::vector<FootHold> holds = Hold(Drift(60, 0.5f), {{20, 40}});
    for (int frame = 23; frame < 37; ++frame)
    {
        EXPECT_EQ(holds[static_cast<size_t>(frame)].share, 1.0f) << frame;
        EXPECT_NEAR(holds[static_cast<size_t>(frame)].place.z, 0.5 * 29.5, 0.1) << frame;
    }
    EXPECT_EQ(holds[18].share, 0.0f);
    EXPECT_EQ(holds[41].share, 0.0f);
    for (size_t frame = 19; frame < 24; ++frame)
        EXPECT_LE(holds[frame - 1].share, holds[frame].share) << frame;
}

TEST(HoldFoot, MotionThatBeginsAndEndsInAContactIsHeldThroughout)
{
    for (const FootHold& hold : Hold(Drift(30, 0.2f), {{0, 30}}))
        EXPECT_EQ(hold.share, 1.0f);
}

TEST(HoldFoot, FootThatIsDraggedIsLedWithSomePlay)
{
    const std::vector<FootHold> holds = Hold(Drift(101, 1.0f), {{0, 101}});
    EXPECT_NEAR(holds[50].place.z, 50.0f, 0.1f);
    EXPECT_NEAR(holds[64].place.z, 50.0f, 0.1f) << "within the play";
    EXPECT_NEAR(holds[100].place.z, 100.0f - kPlay, 0.1f);
    EXPECT_NEAR(holds[0].place.z, kPlay, 0.1f);
}

TEST(HoldFoot, ContactsWithAGapKeepTheirPlaces)
{
    for (const int gap : {1, 2, 3})
    {
        SCOPED_TRACE(gap);
        std::vector<Vec3> path(41, Vec3{0.0f, 80.0f, 0.0f});
        std::fill(path.begin() + 20, path.end(), Vec3{0.0f, 80.0f, 8.0f});
        const std::vector<FootHold> holds = Hold(path, {{0, 20}, {20 + gap, 41}});
        EXPECT_NEAR(holds[19].place.z, 0.0f, 0.01f);
        EXPECT_NEAR(holds[static_cast<size_t>(20 + gap)].place.z, 8.0f, 0.01f);
        EXPECT_GT(holds[19].share, 0.0f);
        EXPECT_GT(holds[static_cast<size_t>(20 + gap)].share, 0.0f);
    }
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

TEST(YieldKnee, BentKneeReachesWhatIsAskedAndAStraightOneKeepsItsAngle)
{
    const LegLengths leg{360.0, 345.0};
    // degrees: degrees
    // more: asked beyond the own reach
    // reached: of that, at the least
    // turned: degrees that the knee may turn
    const std::tuple<const char*, double, double, double, double> rows[] = {
        {"bent, shorter", 60.0, -20.0, -19.0, 10.0},    {"bent, longer", 60.0, 20.0, 18.5, 10.0},
        {"straight, noise", 2.0, -0.3, 0.0, 1.0},       {"straight, longer", 2.0, 30.0, 0.0, 2.1},
        {"out of all reach", 90.0, 900.0, 150.0, 90.0},
    };
    for (const auto& [what, degrees, more, reached, turned] : rows)
    {
        SCOPED_TRACE(what);
        const double angle = degrees / 57.29578;
        const double own = ReachAt(leg, angle);
        const double reach = YieldingReach(leg, own + more, angle, 25.0);
        EXPECT_GE((reach - own) / more, reached / more);
        EXPECT_LE(std::fabs(reach - own), std::fabs(more));
        EXPECT_LE(std::fabs(AngleAt(leg, reach) - angle) * 57.29578, turned);
        EXPECT_LE(reach, 705.0);
    }
}

} // namespace
} // namespace gw
