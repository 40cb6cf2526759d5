// Contacts, slide, sink, turn, tilt and knees of made clips, all within 1 % of what was put in.

#include "Angles.h"
#include "FindContacts.h"
#include "PairedFigures.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <gtest/gtest.h>
#include <tuple>
#include <vector>

namespace gw {
namespace {

constexpr int kFrames = 120;
constexpr int kPeriod = 40; // frames of a step: the foot stands for 24 and swings for 16
constexpr int kStand = 24;

/// How a foot walks on the spot, and what is wrong with it. Lengths in mm, angles in degrees.
struct Step
{
    double drift = 0.0; ///< over each stand, forwards
    double sink = 0.0;
    double turn = 0.0;
    double twist = 0.0; ///< turn that is added over each stand
    double tilt = 0.0;  ///< while it stands
    int early = 0;      ///< frames that it leaves the floor too soon
};

Vec3 FootAt(const Step& step, int frame)
{
    const int phase = frame % kPeriod;
    const int stand = kStand - step.early;
    const auto down = static_cast<float>(-step.sink);
    if (phase < stand)
        return {0.0f, down, static_cast<float>(step.drift * phase / (stand - 1))};
    const double swing = (phase - stand + 1.0) / (kPeriod - stand + 1.0);
    return {0.0f, down + static_cast<float>(150.0 * std::sin(swing * kPi64)),
            static_cast<float>(step.drift + 600.0 * std::sin(swing * kPi64))};
}

FigurePose Walking(const Step& step)
{
    return [=](CMadeFigure& figure, int frame) {
        for (const char* foot : {"LFoot", "RFoot"})
        {
            figure.Move(foot, FootAt(step, frame));
            figure.Turn(foot, kVec3UnitX, frame % kPeriod < kStand ? step.tilt : 20.0);
            const double share = static_cast<double>(frame % kPeriod) / (kStand - 1);
            figure.Turn(foot, kVec3UnitY, step.turn + step.twist * std::min(share, 1.0));
        }
    };
}

ConversionMeasures MeasureWalks(const Step& sourceStep, const Step& resultStep, double sourceUnit = 1.0)
{
    return PairedFigures(sourceUnit).Measure(Walking(sourceStep), Walking(resultStep), kFrames);
}

} // namespace

TEST(MeasureFeet, ContactsAreTheFramesThatStand)
{
    const ConversionMeasures same = MeasureWalks({}, {});
    ASSERT_EQ(same.feet.size(), 2u);
    EXPECT_EQ(same.feet[0].target, "LFoot");
    EXPECT_EQ(same.feet[0].sourceContacts, 3u);
    EXPECT_EQ(same.feet[0].sourceStanding, 3u * kStand);
    EXPECT_DOUBLE_EQ(same.contactF1.value_or(0.0), 1.0);

    const ConversionMeasures early = MeasureWalks({}, {.early = 8});
    const double standing = kStand;
    const double expected = 2.0 * (standing - 8.0) / (standing + standing - 8.0);
    ExpectMeasured(early.contactF1.value_or(0.0), expected);
    EXPECT_EQ(early.feet[0].bothStanding, 3u * (kStand - 8));
}

// An ankle of a leg of 800 mm: it begins to stand below 48 mm and 280 mm/s, and leaves above 80 mm or 480
// mm/s.
TEST(FindContacts, ThresholdsHaveASlack)
{
    constexpr int kFrameCount = 60;
    const std::tuple<const char*, double, std::function<Vec3(int)>, std::vector<int>> rows[] = {
        {"it hovers where a stand begins",
         30.0,
         [](int f) { return kVec3UnitY * (f % 8 < 4 ? 46.0f : 50.0f); },
         {0, 60}},
        {"it rises above where one ends",
         30.0,
         [](int f) { return kVec3UnitY * (f < 20 ? 0.0f : 85.0f); },
         {0, 20}},
        {"it hovers too high from the start", 30.0, [](int) { return kVec3UnitY * 60.0f; }, {}},
        {"it drifts faster and faster",
         30.0,
         [](int f) { return kVec3UnitX * (0.2f * static_cast<float>(f * f)); },
         {0, 41}},
        {"it brushes the floor", 30.0, [](int f) { return kVec3UnitY * (f % 30 < 2 ? 0.0f : 90.0f); }, {}},
        {"it taps the floor for a tenth of a second",
         30.0,
         [](int f) { return kVec3UnitY * (f % 30 < 3 ? 0.0f : 90.0f); },
         {0, 3, 30, 33}},
        {"a fast recording shakes",
         120.0,
         [](int f) { return kVec3UnitX * (f % 2 == 0 ? 3.0f : -3.0f); },
         {0, 60}},
    };
    for (const auto& [what, rate, place, borders] : rows)
    {
        SCOPED_TRACE(what);
        std::vector<Vec3> places(kFrameCount);
        for (int f = 0; f < kFrameCount; ++f)
            places[static_cast<size_t>(f)] = place(f);
        const FloorPath ankle{places, 0.0f};
        std::vector<int> found;
        for (const Contact& contact : FindContacts({&ankle, 1}, 800.0, 1.0 / rate))
            found.insert(found.end(), {contact.first, contact.end});
        EXPECT_EQ(found, borders);
    }
}

TEST(MeasureFeet, AddedSlideIsThatOfTheResultInItsOwnLength)
{
    const double twist = 2.0 * 150.0 * std::sin(5.0 * kDegreesToRadians64); // of the toe, by ten degrees
    // The source, of a figure of the result's size, and the result; the source's unit; slides of ankle and
    // toe.
    const std::tuple<const char*, Step, Step, double, double, double> rows[] = {
        {"the result slides", {}, {.drift = 25.0}, 1.0, 25.0, 25.0},
        {"a source in metres", {}, {.drift = 25.0}, 0.001, 25.0, 25.0},
        {"a source of half the size", {}, {.drift = 25.0}, 0.0005, 25.0, 25.0},
        {"both slide, the result more", {.drift = 10.0}, {.drift = 35.0}, 0.1, 25.0, 25.0},
        {"the result slides less", {.drift = 30.0}, {.drift = 5.0}, 0.001, -25.0, -25.0},
        {"the result turns on its heel", {}, {.twist = 10.0}, 0.01, 0.0, twist},
    };
    for (const auto& [what, sourceStep, resultStep, sourceUnit, ankle, toe] : rows)
    {
        SCOPED_TRACE(what);
        const ConversionMeasures walks = MeasureWalks(sourceStep, resultStep, sourceUnit);
        for (const FootMeasures& foot : walks.feet)
        {
            EXPECT_EQ(foot.ankleSlide.plants, 3u);
            ExpectMeasured(foot.ankleSlide.median, ankle);
            ExpectMeasured(foot.ankleSlide.largest, ankle);
            ExpectMeasured(foot.toeSlide.largest, toe);
        }
        ExpectMeasured(walks.toeSlide.median, toe);
    }
}

TEST(MeasureFeet, SoleStandsAndSinksByItsDepth)
{
    const ConversionMeasures sunk = MeasureWalks({}, {.sink = 12.0});
    ExpectMeasured(sunk.sinkDepth, 12.0);
    ExpectMeasured(sunk.heldSole.value_or(0.0), 12.0);
    EXPECT_DOUBLE_EQ(sunk.contactF1.value_or(0.0), 1.0) << "the floor of a clip is its own";

    const ConversionMeasures floating = MeasureWalks({}, {.sink = -9.0});
    ExpectMeasured(floating.heldSole.value_or(0.0), 9.0);
    EXPECT_EQ(floating.sinkDepth, 0.0);

    // A toe that dips: 150 mm in front of the ankle, 100 mm of it under the joint.
    const ConversionMeasures tilted = MeasureWalks({}, {.tilt = 5.0});
    const double angle = 5.0 * kDegreesToRadians64;
    const double dip = 150.0 * std::sin(angle) - 100.0 * (1.0 - std::cos(angle));
    ExpectMeasured(tilted.sinkDepth, dip);
    ExpectMeasured(tilted.feet[0].soleTiltMean, 5.0);
    ExpectMeasured(tilted.feet[0].soleTiltLargest, 5.0);
    ExpectMeasured(tilted.feet[0].sourceSoleTiltMean, 0.0);

    const auto still = [](CMadeFigure&, int) {};
    const ConversionMeasures pose = PairedFigures().Measure(still, still, 1);
    ASSERT_EQ(pose.feet.size(), 2u);
    EXPECT_FALSE(pose.heldSole || pose.feet[0].heldSole || pose.feet[0].heldSoleLargest)
        << "too short for a contact";
}

TEST(MeasureFeet, TurnIsTheAngleBetweenHeadings)
{
    const std::tuple<const char*, double, double, double> rows[] = {
        {"out", 0.0, 11.0, 11.0},
        {"in", 0.0, -11.0, -11.0},
        {"both", 30.0, 41.0, 11.0},
        {"over the back of a circle", 175.0, -174.0, 11.0},
    };
    for (const auto& [what, sourceTurn, resultTurn, expected] : rows)
    {
        SCOPED_TRACE(what);
        const ConversionMeasures walks = MeasureWalks({.turn = sourceTurn}, {.turn = resultTurn}, 0.01);
        for (const FootMeasures& foot : walks.feet)
        {
            ExpectMeasured(foot.turnMean, expected);
            ExpectMeasured(foot.turnError, 11.0);
            ExpectMeasured(foot.turnLargest, 11.0);
            ExpectMeasured(foot.turnWhileStanding, 11.0);
            EXPECT_FALSE(foot.turnFromStart);
        }
    }
}

// Without a toe joint nobody knows where a foot points; how far it turns is known.
TEST(MeasureFeet, FootWithoutToeTurnsFromItsStart)
{
    PairedFigures figures;
    figures.source.Remove("LToe");
    const auto turning = [](double startTurn, double endTurn) {
        return [=](CMadeFigure& figure, int frame) {
            figure.Turn("LFoot", kVec3UnitY, frame < 1 ? startTurn : endTurn);
        };
    };
    const ConversionMeasures measures = figures.Measure(turning(70.0, 90.0), turning(0.0, 31.0), 200);
    ASSERT_EQ(measures.feet.size(), 2u);
    EXPECT_TRUE(measures.feet[0].turnFromStart);
    ExpectMeasured(measures.feet[0].turnMean, 11.0);
    EXPECT_FALSE(measures.feet[1].turnFromStart);
}

// A knee that bends evenly from second 1 on; the source's a while earlier.
TEST(MeasureFeet, KneePopIsAChangeInTimeThatTheSourceDoesNotMake)
{
    const struct // NOLINT(clang-analyzer-optin.performance.Padding): rows read best in this order
    {
        const char* what;
        int rate;
        double seconds; // in which the result's knee bends
        double degrees;
        double sourceDegrees; // the same in the source
        int framesEarlier;
        size_t pops;
        double largest;
    } rows[] = {
        {"in a frame of 1/30 s", 30, 1.0 / 30.0, 9.0, 0.0, 0, 1, 9.0},
        {"in four frames of 1/120 s", 120, 1.0 / 30.0, 9.0, 0.0, 0, 1, 9.0},
        {"in a tenth of a second", 120, 1.0 / 10.0, 9.0, 0.0, 0, 0, 3.0},
        {"by less than the eye notices", 30, 1.0 / 30.0, 4.5, 0.0, 0, 0, 4.5},
        {"more than the source", 30, 1.0 / 30.0, 9.0, 3.0, 2, 1, 6.0},
        {"as the source 1/15 s before", 30, 1.0 / 30.0, 9.0, 9.0, 2, 0, 0.0},
        {"as the source, but a tenth later", 30, 1.0 / 30.0, 9.0, 9.0, 3, 1, 9.0},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const auto bending = [&](double degrees, int start) {
            const double frames = row.seconds * row.rate;
            return [=](CMadeFigure& figure, int frame) {
                figure.Turn("LCalf", kVec3UnitX, degrees * std::clamp((frame - start) / frames, 0.0, 1.0));
            };
        };
        const ConversionMeasures measures = PairedFigures().Measure(
            bending(row.sourceDegrees, row.rate - row.framesEarlier), bending(row.degrees, row.rate),
            2 * row.rate, 1.0f / static_cast<float>(row.rate));
        EXPECT_EQ(measures.feet[0].kneePops, row.pops);
        EXPECT_NEAR(measures.feet[0].kneePopLargest, row.largest, 0.02);
        EXPECT_EQ(measures.feet[1].kneePops, 0u);
    }
}

} // namespace gw
