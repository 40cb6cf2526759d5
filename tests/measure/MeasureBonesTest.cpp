// Which bones are compared, and directions of made clips, all within 1 % of what was put in.

#include "BonePairs.h"
#include "FrameScale.h"
#include "PairedFigures.h"
#include "TempFolder.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {

TEST(MeasureConversion, DirectionLeadsToTheNextJointThatIsAwayAlongTheBody)
{
    CMadeFigure source;
    CMadeFigure result;
    result.AddBone("Waist", "LowerTorso", {0.0f, 100.0f, 0.0f}); // unmapped: a branch that leads nowhere
    source.AddBone("Helper", "LForearm", kVec3Zero);
    source.AddBone("Twist", "Helper", {0.0f, 0.0f, 0.0f});
    source.AddBone("Wrist", "Twist", {250.0f, 0.0f, 0.0f});
    source.Remove("LHand");
    source.AddBone("ThighTwist", "LThigh", {20.0f, -200.0f, 0.0f});
    source.AddBone("Knee", "ThighTwist", {-20.0f, -200.0f, 0.0f});
    std::vector<BonePair> pairs = PairByName(source, result);
    pairs.push_back({&result.Bone("LHand"), &source.Bone("Wrist")});
    std::ranges::find(pairs, &result.Bone("LCalf"), &BonePair::target)->source = &source.Bone("Knee");
    for (BonePair& pair : pairs)
    {
        if (pair.target == &result.Bone("UpperTorso"))
            pair.source = &source.Bone("LUpperArm");
    }
    const auto leaning = [](CMadeFigure& figure, int) { figure.Turn("UpperTorso", kVec3UnitX, 9.0); };
    const MotionClip clip = source.Record(3, kStill);
    const ConversionMeasures measures = MeasureConversion(clip, result.Record(3, leaning), pairs);
    ExpectMeasured(BoneOf(measures, "UpperTorso").meanError, 9.0);

    const std::tuple<const char*, const char*, const char*, const char*> rows[] = {
        {"a hip leads along its spine", "LowerTorso", "UpperTorso", "UpperTorso"},
        {"a collar that drives a torso is measured as a torso", "UpperTorso", "Neck", "Neck"},
        {"helpers at one place are passed", "LForearm", "LHand", "Wrist"},
        {"a limb leads past a twist joint", "LThigh", "LCalf", "Knee"},
        {"a foot leads to its toe", "LFoot", "LToe", "LToe"},
        {"an end joint leads nowhere", "Head", "", ""},
    };
    for (const auto& [what, target, targetChild, sourceChild] : rows)
    {
        SCOPED_TRACE(what);
        const BoneMeasures bone = BoneOf(measures, target);
        EXPECT_EQ(bone.targetChild, targetChild);
        EXPECT_EQ(bone.sourceChild, sourceChild);
        EXPECT_EQ(bone.measured, *targetChild != '\0');
    }
}

// What is in the source at frame f is in the result at f x scale, whatever the count was cut to.
TEST(MeasureConversion, ResultOfAnotherRateIsSampledAtTheSourcesInstants)
{
    const std::tuple<const char*, int, int, double, int> rows[] = {
        {"interactive save at 30", 101, 404, 4.0, 101},
        {"at 25: 484.8 frames are cut", 101, 484, 4.8, 101},
        {"at 120", 101, 101, 1.0, 101},
        {"at 240: half of an odd number", 101, 50, 0.5, 99},
        {"at 7", 33, 565, 120.0 / 7.0, 33},
        {"a scale of no whole rate", 101, 333, 333.0 / 101, 101},
    };
    for (const auto& [what, sourceFrames, resultFrames, scale, compared] : rows)
    {
        SCOPED_TRACE(what);
        EXPECT_DOUBLE_EQ(FrameScaleOf(sourceFrames, resultFrames), scale);
        const auto swinging = [](double slower) {
            return [=](CMadeFigure& figure, int f) { figure.Turn("LForearm", kVec3UnitZ, 1.5 * f / slower); };
        };
        CMadeFigure source;
        CMadeFigure result;
        const MotionClip sourceClip = source.Record(sourceFrames, swinging(1.0), 1.0f / 60.0f);
        const MotionClip resultClip = result.Record(resultFrames, swinging(scale), 1.0f / 60.0f);
        const ConversionMeasures measures =
            MeasureConversion(sourceClip, resultClip, PairByName(source, result));
        EXPECT_EQ(measures.frameCount, compared);
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

    ConversionDetail detail;
    const ConversionMeasures unmapped = MeasureConversion(clip, still, {}, &detail);
    EXPECT_EQ(unmapped.frameCount, 1);
    EXPECT_TRUE(detail.meanError.empty() && detail.feet.empty() && detail.sourceHips.empty());
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
    const ConversionMeasures measures = PairedFigures().Measure(leaping, leaping, 30);
    EXPECT_TRUE(std::isfinite(measures.meanError) && std::isfinite(measures.largestError));
    EXPECT_TRUE(std::isfinite(measures.toeSlide.largest) &&
                std::isfinite(measures.travelRatio.value_or(0.0)));
    EXPECT_TRUE(std::isfinite(measures.trunkLargest) && std::isfinite(measures.handGap.value_or(0.0)));
    EXPECT_TRUE(std::isfinite(measures.sinkDepth) && std::isfinite(measures.resultLeg));
}

TEST(BonePairs, ProfileRowsBecomePairsAndMisfits)
{
    const CMadeFigure figure;
    CNode* const root = &figure.Bone("LowerTorso");
    const CTempFolder folder;
    const std::string path = folder.Path("map.prf");
    WriteBytes(path, "A map\nFrameRate 30\nPosition 0 0 0\n"
                     "LowerTorso <---> LowerTorso 0,0,0,1,2,3\n"
                     "* LThigh . .1,2,3\n"
                     "Neck <---> Head 0,0,0,1,2,3\n"
                     "Tail <---> Head 0,0,0,1,2,3\n"
                     "rcalf <---> RCalf 0,90,0,1,2,3\n"
                     "Head <---> Head 0,0,0,1,2,3\n");
    std::vector<BonePair> pairs;
    std::vector<MissingBone> missing;
    ASSERT_TRUE(ReadBonePairs(path, root, root, pairs, missing));

    std::string names;
    for (const BonePair& pair : pairs)
        names += std::string(pair.source->NameView()) + '>' + pair.target->GetName() + ' ';
    EXPECT_EQ(names, "LowerTorso>LowerTorso Head>Head RCalf>RCalf ") << "of two rows, the later counts";
    ASSERT_EQ(missing.size(), 1u);
    EXPECT_EQ(missing[0].line, 7u);
    EXPECT_EQ(missing[0].name, "Tail");
    EXPECT_EQ(missing[0].side, ESkeletonSide::Source);

    EXPECT_FALSE(ReadBonePairs(folder.Path("gone.prf"), root, root, pairs, missing));
    EXPECT_EQ(pairs.size(), 3u) << "a profile that is gone changes nothing";
}

} // namespace gw
