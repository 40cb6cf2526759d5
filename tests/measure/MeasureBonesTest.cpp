// Directions of made clips, all within 1 % of what was put in.

#include "Angles.h"
#include "FrameScale.h"
#include "PairedFigures.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace gw {
namespace {

const auto kStill = [](CMadeFigure&, int) {};

const BoneMeasures& BoneOf(const ConversionMeasures& measures, const std::string& target)
{
    static const BoneMeasures kNone;
    const auto found = std::ranges::find(measures.bones, target, &BoneMeasures::target);
    return found == measures.bones.end() ? kNone : *found;
}

} // namespace

TEST(MeasureConversion, TurnedBoneIsOffByItsAngle)
{
    CMadeFigure source;
    CMadeFigure result;
    const MotionClip sourceClip = source.Record(40, kStill);
    const MotionClip resultClip = result.Record(40, [](CMadeFigure& figure, int frame) {
        figure.Turn("LForearm", kVec3UnitZ, frame < 30 ? 7.0 : 13.0);
    });
    const ConversionMeasures measures = MeasureConversion(sourceClip, resultClip, PairByName(source, result));

    const BoneMeasures& forearm = BoneOf(measures, "LForearm");
    ExpectMeasured(forearm.meanError, 8.5);
    ExpectMeasured(forearm.largestError, 13.0);
    EXPECT_EQ(forearm.largestFrame, 30);
    ExpectMeasured(BoneOf(measures, "LUpperArm").largestError, 0.0);
    const auto measured = std::ranges::count_if(measures.bones, &BoneMeasures::measured);
    ExpectMeasured(measures.meanError, 8.5 / static_cast<double>(measured));
}

TEST(MeasureConversion, DirectionLeadsToTheNextJointThatIsAway)
{
    CMadeFigure source;
    CMadeFigure result;
    result.AddBone("Waist", "LowerTorso", {0.0f, 100.0f, 0.0f}); // unmapped: a branch that leads nowhere
    source.AddBone("Helper", "LForearm", kVec3Zero);
    source.AddBone("Twist", "Helper", {0.0f, 0.0f, 0.0f});
    source.AddBone("Wrist", "Twist", {250.0f, 0.0f, 0.0f});
    source.Remove("LHand");
    std::vector<BonePair> pairs = PairByName(source, result);
    pairs.push_back({&result.Bone("LHand"), &source.Bone("Wrist")});
    const MotionClip clip = source.Record(3, kStill);
    const ConversionMeasures measures = MeasureConversion(clip, result.Record(3, kStill), pairs);

    const struct
    {
        const char* what;
        const char* target;
        const char* targetChild;
        const char* sourceChild;
    } rows[] = {
        {"a hip leads along its spine", "LowerTorso", "UpperTorso", "UpperTorso"},
        {"a chest leads to its neck", "UpperTorso", "Neck", "Neck"},
        {"helpers at one place are passed", "LForearm", "LHand", "Wrist"},
        {"a foot leads to its toe", "LFoot", "LToe", "LToe"},
        {"an end joint leads nowhere", "Head", "", ""},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const BoneMeasures& bone = BoneOf(measures, row.target);
        EXPECT_EQ(bone.targetChild, row.targetChild);
        EXPECT_EQ(bone.sourceChild, row.sourceChild);
        EXPECT_EQ(bone.measured, *row.targetChild != '\0');
    }
}

TEST(MeasureConversion, ACollarThatDrivesATorsoIsMeasuredAsATorso)
{
    CMadeFigure source;
    CMadeFigure result;
    std::vector<BonePair> pairs = PairByName(source, result);
    for (BonePair& pair : pairs)
    {
        if (pair.target == &result.Bone("UpperTorso"))
            pair.source = &source.Bone("LUpperArm");
    }
    const auto leaning = [](CMadeFigure& figure, int) { figure.Turn("UpperTorso", kVec3UnitX, 9.0); };
    const MotionClip clip = source.Record(5, kStill);
    const BoneMeasures torso =
        BoneOf(MeasureConversion(clip, result.Record(5, leaning), pairs), "UpperTorso");
    EXPECT_EQ(torso.source, "LUpperArm");
    EXPECT_EQ(torso.sourceChild, "Neck");
    ExpectMeasured(torso.meanError, 9.0);
}

// What is in the source at frame f is in the result at f x scale, whatever the count was cut to.
TEST(MeasureConversion, ResultOfAnotherRateIsSampledAtTheSourcesInstants)
{
    const struct
    {
        const char* what;
        int sourceFrames;
        int resultFrames;
        double scale;
        int compared;
    } rows[] = {
        {"interactive save at 30", 101, 404, 4.0, 101},
        {"at 25: 484.8 frames are cut", 101, 484, 4.8, 101},
        {"at 120", 101, 101, 1.0, 101},
        {"at 240: half of an odd number", 101, 50, 0.5, 99},
        {"at 7", 33, 565, 120.0 / 7.0, 33},
        {"a scale of no whole rate", 101, 333, 333.0 / 101, 101},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        EXPECT_DOUBLE_EQ(FrameScaleOf(row.sourceFrames, row.resultFrames), row.scale);
        const auto swinging = [](double scale) {
            return
                [scale](CMadeFigure& figure, int f) { figure.Turn("LForearm", kVec3UnitZ, 1.5 * f / scale); };
        };
        CMadeFigure source;
        CMadeFigure result;
        const MotionClip sourceClip = source.Record(row.sourceFrames, swinging(1.0), 1.0f / 60.0f);
        const MotionClip resultClip = result.Record(row.resultFrames, swinging(row.scale), 1.0f / 60.0f);
        const ConversionMeasures measures =
            MeasureConversion(sourceClip, resultClip, PairByName(source, result));
        EXPECT_EQ(measures.frameCount, row.compared);
        EXPECT_LT(BoneOf(measures, "LForearm").meanError, 0.01);
    }
}

TEST(MeasureConversion, WhatCannotBeMeasuredHasNoFigures)
{
    CMadeFigure source;
    CMadeFigure result;
    const std::vector<BonePair> pairs = PairByName(source, result);
    const MotionClip clip = source.Record(1, kStill);
    const MotionClip still = result.Record(1, kStill);
    EXPECT_EQ(MeasureConversion({}, still, pairs).frameCount, 0);
    EXPECT_EQ(MeasureConversion(clip, {still.root, still.frequency, 0}, pairs).frameCount, 0);

    const ConversionMeasures unmapped = MeasureConversion(clip, still, {});
    EXPECT_EQ(unmapped.frameCount, 1);
    EXPECT_TRUE(unmapped.bones.empty() && unmapped.feet.empty());
    EXPECT_FALSE(unmapped.contactF1 || unmapped.travelRatio || unmapped.jitterRatio || unmapped.heldSole);

    const ConversionMeasures oneFrame = MeasureConversion(clip, still, pairs);
    EXPECT_EQ(oneFrame.feet.size(), 2u);
    ExpectMeasured(oneFrame.largestError, 0.0);
    EXPECT_FALSE(oneFrame.jitterRatio || oneFrame.travelRatio);
}

// Files may hold positions of which the differences are infinite.
TEST(MeasureConversion, FiguresAreFiniteWhateverThePositions)
{
    const auto leaping = [](CMadeFigure& figure, int frame) {
        figure.Move("LFoot", {frame % 3 == 0 ? 3e38f : -3e38f, 0.0f, 1.0f});
        figure.Move("LowerTorso", {0.0f, 0.0f, frame % 2 == 0 ? 3e38f : -3e38f});
    };
    CMadeFigure source;
    CMadeFigure result;
    const MotionClip clip = source.Record(30, leaping);
    const ConversionMeasures measures =
        MeasureConversion(clip, result.Record(30, leaping), PairByName(source, result));
    EXPECT_TRUE(std::isfinite(measures.meanError) && std::isfinite(measures.largestError));
    EXPECT_TRUE(std::isfinite(measures.toeSlide.largest) &&
                std::isfinite(measures.travelRatio.value_or(0.0)));
    EXPECT_TRUE(std::isfinite(measures.trunkLargest) && std::isfinite(measures.handGap.value_or(0.0)));
    EXPECT_TRUE(std::isfinite(measures.sinkDepth) && std::isfinite(measures.resultLeg));
}

} // namespace gw
