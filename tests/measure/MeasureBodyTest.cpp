// Hips, trunk, legs' jitter and hands of made clips, all within 1 % of what was put in.

#include "Angles.h"
#include "PairedFigures.h"

#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {

// The hip joints hang under the root, so a root that leans from side to side swings them.
TEST(MeasureBody, TravelIsThePathOfTheHipJoints)
{
    const auto walking = [](float step, double lean) {
        return [=](CMadeFigure& figure, int frame) {
            figure.Move("LowerTorso", {0.0f, 0.0f, step * static_cast<float>(frame)});
            figure.Turn("LowerTorso", kVec3UnitZ, frame % 2 == 0 ? lean : -lean);
            for (const char* thigh : {"LThigh", "RThigh"})
                figure.Move(thigh, {0.0f, -138.0f, 0.0f});
        };
    };
    PairedFigures figures(0.0005);
    const ConversionMeasures walk = figures.Measure(walking(20.0f, 0.0), walking(20.0f, 2.0), 121);
    ExpectMeasured(walk.resultLeg, 800.0);
    ExpectMeasured(walk.sourceTravel, 3.0);
    ExpectMeasured(walk.travelRatio.value_or(0.0),
                   std::hypot(20.0, 2.0 * 138.0 * std::sin(2.0 * kDegreesToRadians64)) / 20.0);

    EXPECT_FALSE(PairedFigures().Measure(walking(4.0f, 0.0), walking(20.0f, 2.0), 121).travelRatio);
}

// The result's neck is farther back than the source's in the rest pose, and so it stays.
TEST(MeasureBody, TrunkIsTheAngleOfTheLineFromHipsToNeckLessThatAtRest)
{
    PairedFigures figures(0.01);
    figures.result.Remove("Neck");
    figures.result.AddBone("Neck", "UpperTorso", {0.0f, 250.0f, -60.0f});
    figures.result.AddBone("Head", "Neck", {0.0f, 90.0f, 0.0f});
    const auto bowing = [](double more) {
        return [=](CMadeFigure& figure, int frame) {
            figure.Turn("LowerTorso", kVec3UnitX, frame + (frame >= 90 ? more : 0.0));
            figure.Turn("LowerTorso", kVec3UnitY, 2.0 * frame);
        };
    };
    const ConversionMeasures measures = figures.Measure(bowing(0.0), bowing(9.0), 100);
    ExpectMeasured(measures.trunkMean.value_or(0.0), 0.9);
    ExpectMeasured(measures.trunkMost.value_or(0.0), 9.0);
    EXPECT_EQ(measures.trunkFrame / 10, 9);
    ASSERT_EQ(figures.detail.trunkError.size(), 100u);
    EXPECT_NEAR(figures.detail.trunkError[89], 0.0f, 0.01f);
}

// At 120 frames a second, four frames are a thirtieth of a second: what shakes from frame to frame is not
// seen.
TEST(MeasureBody, JitterIsThatOfTheLegsAtThirtyHertz)
{
    const auto shaking = [](double left, double right, double fast) {
        return [=](CMadeFigure& figure, int frame) {
            const double sign = frame / 4 % 2 == 0 ? 1.0 : -1.0;
            const double blur = frame % 4 == 2 ? fast : 0.0;
            figure.Turn("LThigh", kVec3UnitX, sign * left + blur);
            figure.Turn("RThigh", kVec3UnitX, sign * right + blur);
        };
    };
    const ConversionMeasures measures =
        PairedFigures().Measure(shaking(0.4, 0.4, 0.0), shaking(1.2, 0.4, 5.0), 241, 1.0f / 120.0f);
    ExpectMeasured(measures.jitterRatioLargest.value_or(0.0), 3.0);
    ExpectMeasured(measures.jitterRatio.value_or(0.0), 2.0); // thigh and calf of one leg 3, of the other 1

    EXPECT_FALSE(PairedFigures().Measure(kStill, shaking(1.2, 0.4, 5.0), 241, 1.0f / 120.0f).jitterRatio);
}

TEST(MeasureBody, AHandKeepsItsGapToWhatTheSourceTouches)
{
    const Vec3 rest{710.0f, 1400.0f, 0.0f}; // of the left hand, with an arm that stretches sideways
    // Places in mm of a figure of the result's size, the gap between them, and the result's depth.
    const std::tuple<const char*, Vec3, Vec3, double, double> rows[] = {
        {"thigh", {100.0f, 700.0f, 60.0f}, {100.0f, 650.0f, 95.0f}, 35.0, 0.0},
        {"torso", {0.0f, 1200.0f, 80.0f}, {0.0f, 1250.0f, 20.0f}, 60.0, 0.0},
        {"head", {0.0f, 1647.0f, 100.0f}, {0.0f, 1647.0f, 140.0f}, 40.0, 0.0},
        {"other hand", {-710.0f, 1400.0f, 60.0f}, {-710.0f, 1400.0f, 95.0f}, 35.0, 0.0},
        {"floor", {400.0f, 50.0f, 400.0f}, {400.0f, -30.0f, 400.0f}, 80.0, 30.0},
        {"", {400.0f, 300.0f, 400.0f}, {400.0f, -30.0f, 400.0f}, 0.0, 30.0},
    };
    for (const auto& [part, sourcePlace, resultPlace, gap, depth] : rows)
    {
        SCOPED_TRACE(part);
        PairedFigures figures(0.0005);
        for (CMadeFigure* figure : {&figures.source, &figures.result})
            figure->AddBone("RHand", "RUpperArm", {-530.0f, 0.0f, 0.0f});
        const auto holding = [&](const Vec3& place) {
            return [=](CMadeFigure& figure, int frame) {
                figure.Move("LHand", frame < 4 || frame >= 24 ? kVec3Zero : place - rest);
            };
        };
        const ConversionMeasures measures = figures.Measure(holding(sourcePlace), holding(resultPlace), 30);
        ASSERT_EQ(measures.hands.size(), 2u);
        const HandMeasures& hand = measures.hands[0];
        EXPECT_EQ(hand.gapPart, part);
        EXPECT_EQ(hand.touchFrames, *part ? 20u : 0u);
        EXPECT_EQ(hand.gap.has_value(), *part != '\0');
        ExpectMeasured(measures.handGap.value_or(0.0), gap);
        ExpectMeasured(measures.handDepth.value_or(0.0), depth);
    }
}

} // namespace gw
