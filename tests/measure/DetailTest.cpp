// What a comparison keeps frame by frame, and which frames it names.

#include "PairedFigures.h"
#include "WorstFrames.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr int kFrames = 120;

PartMeasures PartOf(const ConversionDetail& detail, std::string_view name)
{
    const auto found = std::ranges::find(detail.parts, name, &PartMeasures::name);
    return found == detail.parts.end() ? PartMeasures() : *found;
}

} // namespace

TEST(ConversionDetail, BonesAreOffByTheirTurnsAndPartsTakeBothSidesTogether)
{
    constexpr double kLeftCalf = 4.0 + 8.0 / kFrames;
    const auto turned = [](CMadeFigure& figure, int frame) {
        figure.Turn("LCalf", kVec3UnitX, frame == 50 ? 12.0 : 4.0);
        figure.Turn("RCalf", kVec3UnitX, 2.0);
        figure.Turn("Head", kVec3UnitX, 9.0); // an end joint: its bone's own axis is looked at
    };
    PairedFigures figures;
    const ConversionMeasures measures = figures.Measure(kStill, turned, kFrames);
    const BoneMeasures left = BoneOf(measures, "LCalf");
    ExpectMeasured(left.meanError, kLeftCalf);
    ExpectMeasured(left.largestError, 12.0);
    EXPECT_EQ(left.largestFrame, 50);
    const auto measured = std::ranges::count_if(measures.bones, &BoneMeasures::measured);
    ExpectMeasured(measures.meanError, 2.0 * (kLeftCalf + 2.0) / static_cast<double>(measured)); // feet too
    const ConversionDetail& detail = figures.detail;
    const PartMeasures calf = PartOf(detail, "calf");
    EXPECT_EQ(calf.boneCount, 2u);
    ExpectMeasured(calf.meanError, (kLeftCalf + 2.0) / 2.0);
    ExpectMeasured(calf.largestError, 12.0);
    EXPECT_EQ(calf.largestBone, "LCalf");
    EXPECT_EQ(calf.largestFrame, 50);
    ExpectMeasured(PartOf(detail, "thigh").largestError, 0.0);
    EXPECT_EQ(PartOf(detail, "head").boneCount, 1u);
    ExpectMeasured(PartOf(detail, "head").meanError, 9.0);
}

// A source of half the size in metres that stands 300 mm above its origin; the result sinks by 20 mm.
TEST(ConversionDetail, CurvesStandSideBySideInTheResultsUnit)
{
    const auto moved = [](float height, float step) {
        return [=](CMadeFigure& figure, int frame) {
            figure.Move("LowerTorso", {0.0f, height, step * static_cast<float>(frame)});
            figure.Turn("LCalf", kVec3UnitX, -0.1 * frame); // forwards and up
        };
    };
    PairedFigures figures(0.0005);
    figures.Measure(moved(300.0f, 4.0f), moved(-20.0f, 5.0f), kFrames);
    const ConversionDetail& detail = figures.detail;
    ASSERT_EQ(detail.feet.size(), 2u);
    EXPECT_NEAR(detail.feet[1].sourceSole[60], 0.0, 0.1);
    EXPECT_NEAR(detail.feet[1].resultSole[60], -20.0, 0.1);
    EXPECT_NEAR(detail.feet[0].sourceKnee[100], 10.0, 0.01);
    EXPECT_NEAR(detail.feet[0].resultKnee[100], 10.0, 0.01);
    ASSERT_EQ(detail.sourceHips.size(), static_cast<size_t>(kFrames));
    EXPECT_NEAR(detail.sourceHips[100].z, 400.0, 0.1);
    EXPECT_NEAR(detail.resultHips[100].z, 500.0, 0.1);
    EXPECT_NEAR(detail.sourceHips[0].y, 900.0, 0.1);
    EXPECT_NEAR(detail.resultHips[0].y, 880.0, 0.1);
}

// Hips at the origin and nothing below the ankles: the floor is where the result's would be.
TEST(ConversionDetail, ASourceThatEndsAtItsAnklesStandsAboveItsFloor)
{
    PairedFigures figures;
    for (const std::string side : {"L", "R"})
    {
        figures.source.Remove(side + "Foot");
        figures.source.AddBone(side + "Foot", side + "Calf", {0.0f, -500.0f, 0.0f});
    }
    figures.Measure(kStill, kStill, 5);
    const ConversionDetail& detail = figures.detail;
    ASSERT_EQ(detail.feet.size(), 2u);
    EXPECT_NEAR(detail.feet[0].sourceSole[2], 0.0, 0.1);
    EXPECT_NEAR(detail.sourceFloor, -112.5, 0.1);
    EXPECT_NEAR(detail.sourceHips[2].y, 900.0, 0.1);
}

TEST(WorstFrames, AreThoseOfTheFaultsThatWereMade)
{
    const auto faulty = [](CMadeFigure& figure, int frame) {
        figure.Turn("LForearm", kVec3UnitZ, frame == 20 ? 60.0 : 1.0);
        figure.Turn("LCalf", kVec3UnitX, frame == 40 ? 14.0 : frame == 41 ? 2.0 : 0.0);
        figure.Move("LowerTorso", {frame == 77 ? 150.0f : 0.0f, 0.0f, 0.0f});
    };
    PairedFigures figures;
    const ConversionMeasures measures = figures.Measure(kStill, faulty, kFrames);
    const std::vector<WorstFrame> worst = FindWorstFrames(measures, figures.detail, 5);
    const std::tuple<EFrameFault, int, double, const char*> rows[] = {
        {EFrameFault::AnkleSlide, 77, 150.0, "LFoot"},
        {EFrameFault::ToeSlide, 77, 150.0, "LFoot"},
        {EFrameFault::KneePop, 40, 14.0, "LFoot"},
        {EFrameFault::HeldSole, 40, 21.4, "LFoot"}, // the toe, which the calf lifts
        {EFrameFault::Direction, 20, 60.0 / static_cast<double>(figures.detail.mainBones.size()), "LForearm"},
    };
    ASSERT_EQ(worst.size(), std::size(rows));
    for (size_t i = 0; i < worst.size(); ++i)
    {
        const auto& [fault, frame, amount, target] = rows[i];
        EXPECT_EQ(worst[i].fault, fault);
        EXPECT_EQ(worst[i].frame, frame);
        EXPECT_NEAR(worst[i].amount, amount, 0.1);
        EXPECT_EQ(worst[i].target, target);
    }
    EXPECT_NEAR(worst[4].most, 60.0, 0.1);
    EXPECT_EQ(measures.feet[0].kneePopFrames, std::vector<int>{40}) << "there and back is one pop";
}

TEST(WorstFrames, AreFilledUpWithDirectionsThatLieApart)
{
    const auto faulty = [](CMadeFigure& figure, int frame) {
        figure.Turn("LForearm", kVec3UnitZ, 60.0 - std::min(std::abs(frame - 30), std::abs(frame - 90)));
    };
    PairedFigures figures;
    const ConversionMeasures measures = figures.Measure(kStill, faulty, kFrames);
    const std::vector<WorstFrame> worst = FindWorstFrames(measures, figures.detail, 4);
    ASSERT_EQ(worst.size(), 4u);
    for (size_t i = 0; i < worst.size(); ++i)
    {
        for (size_t j = i + 1; j < worst.size(); ++j)
            EXPECT_GE(std::abs(worst[i].frame - worst[j].frame), 15) << i << ' ' << j;
    }
    EXPECT_EQ(std::min(worst[0].frame, worst[1].frame), 30);
    EXPECT_EQ(std::max(worst[0].frame, worst[1].frame), 90);

    PairedFigures still;
    const ConversionMeasures same = still.Measure(kStill, kStill, kFrames);
    EXPECT_TRUE(FindWorstFrames(same, still.detail, 3).empty()) << "nothing is bad";
}

} // namespace gw
