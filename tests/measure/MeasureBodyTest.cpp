// Hips, trunk, legs' jitter and hands of made clips, all within 1 % of what was put in.

#include "Angles.h"
#include "PairedFigures.h"

#include <cmath>
#include <gtest/gtest.h>

namespace gw {

namespace {

const auto kStill = [](CMadeFigure&, int) {};

double SinOf(double degrees)
{
    return std::sin(degrees * kDegreesToRadians64);
}

} // namespace

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
    CMadeFigure source(0.0005);
    CMadeFigure result;
    const MotionClip sourceClip = source.Record(121, walking(20.0f, 0.0));
    const MotionClip resultClip = result.Record(121, walking(20.0f, 2.0));
    const ConversionMeasures walk = MeasureConversion(sourceClip, resultClip, PairByName(source, result));
    ExpectMeasured(walk.resultLeg, 800.0);
    ExpectMeasured(walk.sourceTravel, 3.0);
    ExpectMeasured(walk.travelRatio.value_or(0.0), std::hypot(20.0, 2.0 * 138.0 * SinOf(2.0)) / 20.0);

    CMadeFigure near;
    const MotionClip nearClip = near.Record(121, walking(4.0f, 0.0));
    EXPECT_FALSE(MeasureConversion(nearClip, resultClip, PairByName(near, result)).travelRatio);
}

// The result's neck is farther back than the source's in the rest pose, and so it stays.
TEST(MeasureBody, TrunkIsTheAngleOfTheLineFromHipsToNeckLessThatAtRest)
{
    CMadeFigure source(0.01);
    CMadeFigure result;
    result.Remove("Neck");
    result.AddBone("Neck", "UpperTorso", {0.0f, 250.0f, -60.0f});
    result.AddBone("Head", "Neck", {0.0f, 90.0f, 0.0f});
    const auto bowing = [](double more) {
        return [=](CMadeFigure& figure, int frame) {
            figure.Turn("LowerTorso", kVec3UnitX, frame + (frame >= 90 ? more : 0.0));
            figure.Turn("LowerTorso", kVec3UnitY, 2.0 * frame);
        };
    };
    const std::vector<BonePair> pairs = PairByName(source, result);
    const MotionClip clip = source.Record(100, bowing(0.0));
    const MotionClip resultClip = result.Record(100, bowing(9.0));
    ConversionDetail detail;
    const ConversionMeasures measures = MeasureConversion(clip, resultClip, pairs, &detail);
    ExpectMeasured(measures.trunkMean.value_or(0.0), 0.9);
    ExpectMeasured(measures.trunkMost.value_or(0.0), 9.0);
    EXPECT_EQ(measures.trunkFrame / 10, 9);
    ASSERT_EQ(detail.trunkError.size(), 100u);
    EXPECT_NEAR(detail.trunkError[89], 0.0f, 0.01f);
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
    CMadeFigure source;
    CMadeFigure result;
    const MotionClip sourceClip = source.Record(241, shaking(0.4, 0.4, 0.0), 1.0f / 120.0f);
    const MotionClip resultClip = result.Record(241, shaking(1.2, 0.4, 5.0), 1.0f / 120.0f);
    const ConversionMeasures measures = MeasureConversion(sourceClip, resultClip, PairByName(source, result));
    ExpectMeasured(measures.jitterRatioLargest.value_or(0.0), 3.0);
    ExpectMeasured(measures.jitterRatio.value_or(0.0), 2.0); // thigh and calf of one leg 3, of the other 1

    CMadeFigure still;
    const MotionClip stillClip = still.Record(241, kStill, 1.0f / 120.0f);
    EXPECT_FALSE(MeasureConversion(stillClip, resultClip, PairByName(still, result)).jitterRatio);
}

TEST(MeasureBody, AHandKeepsItsGapToWhatTheSourceTouches)
{
    const Vec3 rest{710.0f, 1400.0f, 0.0f}; // of the left hand, with an arm that stretches sideways
    const struct
    {
        const char* part;
        Vec3 source; // in mm of a figure of the result's size
        Vec3 result;
        double gap;
        double depth;
    } rows[] = {
        {"thigh", {100.0f, 700.0f, 60.0f}, {100.0f, 650.0f, 95.0f}, 35.0, 0.0},
        {"torso", {0.0f, 1200.0f, 80.0f}, {0.0f, 1250.0f, 20.0f}, 60.0, 0.0},
        {"head", {0.0f, 1647.0f, 100.0f}, {0.0f, 1647.0f, 140.0f}, 40.0, 0.0},
        {"other hand", {-710.0f, 1400.0f, 60.0f}, {-710.0f, 1400.0f, 95.0f}, 35.0, 0.0},
        {"floor", {400.0f, 50.0f, 400.0f}, {400.0f, -30.0f, 400.0f}, 80.0, 30.0},
        {"", {400.0f, 300.0f, 400.0f}, {400.0f, -30.0f, 400.0f}, 0.0, 30.0},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.part);
        CMadeFigure source(0.0005);
        CMadeFigure result;
        for (CMadeFigure* figure : {&source, &result})
            figure->AddBone("RHand", "RUpperArm", {-530.0f, 0.0f, 0.0f});
        const auto holding = [&](const Vec3& place) {
            return [=](CMadeFigure& figure, int frame) {
                figure.Move("LHand", frame < 4 || frame >= 24 ? kVec3Zero : place - rest);
            };
        };
        const MotionClip sourceClip = source.Record(30, holding(row.source));
        const MotionClip resultClip = result.Record(30, holding(row.result));
        const ConversionMeasures measures =
            MeasureConversion(sourceClip, resultClip, PairByName(source, result));
        ASSERT_EQ(measures.hands.size(), 2u);
        const HandMeasures& hand = measures.hands[0];
        EXPECT_EQ(hand.gapPart, row.part);
        EXPECT_EQ(hand.touchFrames, *row.part ? 20u : 0u);
        EXPECT_EQ(hand.gap.has_value(), *row.part != '\0');
        ExpectMeasured(measures.handGap.value_or(0.0), row.gap);
        ExpectMeasured(measures.handDepth.value_or(0.0), row.depth);
    }
}

} // namespace gw
