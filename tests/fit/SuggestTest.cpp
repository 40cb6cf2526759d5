#include "Angles.h"
#include "ApplyRow.h"
#include "BodyJoints.h"
#include "BoneOffset.h"
#include "CMadeSkeleton.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "FindBone.h"
#include "MeasureConversion.h"
#include "ProfileFit.h"
#include "SuggestProfile.h"
#include "TempFolder.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <memory>
#include <random>
#include <tuple>

namespace gw {
namespace {

std::unique_ptr<CMotionFile> LoadTarget()
{
    auto target = std::make_unique<CMotionFile>();
    EXPECT_TRUE(target->Load(GAITWRIGHT_ASSETS "base.htr"));
    return target;
}

const SuggestedRow& RowOf(const SuggestedProfile& profile, std::string_view target)
{
    return *std::ranges::find(profile.rows, target, &SuggestedRow::target);
}

// Converts with a profile's rows, without options, and reads the result from its file.
std::unique_ptr<CMotionFile> Convert(const CMotionFile& source, const CMapRowTable& rows)
{
    const auto target = LoadTarget();
    CRetargeter retargeter;
    retargeter.SetScenes(source.motionRoot.Get(), target->motionRoot.Get());
    retargeter.LoadShares(GAITWRIGHT_ASSETS "KsBone.bsm");
    const CBoneNames sources(source.motionRoot.Get());
    const CBoneNames targets(target->motionRoot.Get());
    EXPECT_EQ(ApplyRows(rows, sources, targets, &retargeter).foundCount, rows.RowCount());
    retargeter.Retarget(0.0f, source.GetLastFrame(), 0.0f, source.GetFrequency(), kVec3Zero, true, false);
    const CTempFolder folder;
    auto result = std::make_unique<CMotionFile>();
    EXPECT_TRUE(target->Save(folder.Path("result.htr"), 1.0f));
    EXPECT_TRUE(result->Load(folder.Path("result.htr")));
    return result;
}

ConversionMeasures Measure(const CMotionFile& source, const CMapRowTable& rows)
{
    const auto result = Convert(source, rows);
    std::vector<BonePair> pairs;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        if (!rows.IsFixed(row))
            pairs.push_back({FindBone(result->motionRoot.Get(), rows.Text(row, kTargetColumn)),
                             FindBone(source.motionRoot.Get(), rows.Text(row, kSourceColumn))});
    }
    return MeasureConversion(ClipOf(source), ClipOf(*result), pairs);
}

TEST(SuggestProfile, EveryMadeSkeletonPointsAsItsSourceAtRestAndInEveryFrame)
{
    for (const std::string& recipe : SkeletonRecipes())
    {
        SCOPED_TRACE(recipe);
        // A collar without a source shares the arm's rotation, so the arm below it is a degree or two off.
        const double share = recipe.find("noclavicle") == recipe.npos ? 0.0 : 1.0;
        const CMadeSkeleton made(recipe, 1);
        const CMadeSkeleton atRest(recipe + " rest", 1);
        const auto target = LoadTarget();
        const SuggestedProfile profile = SuggestProfile(made.Root(), *target->motionRoot);
        EXPECT_TRUE(profile.missing.empty());
        const CMapRowTable table = profile.Table();
        EXPECT_TRUE(MeasureFit(table, &made.Root(), target->motionRoot.Get()).IsWhole());
        const ConversionMeasures measures = Measure(atRest.Motion(), table);
        double sum = 0.0;
        int count = 0;
        for (const BoneMeasures& bone : measures.bones)
        {
            const SuggestedRow& row = RowOf(profile, bone.target);
            if (!bone.measured || row.kind != ESuggestedRow::Turned)
                continue;
            EXPECT_LT(bone.meanError, 1.0 + share) << bone.target;
            ASSERT_TRUE(row.restError) << bone.target;
            EXPECT_NEAR(bone.meanError, *row.restError, 0.4 + 1.5 * share) << bone.target;
            sum += bone.meanError;
            ++count;
        }
        EXPECT_GE(count, 8);
        EXPECT_LT(sum / count, 0.5 + 0.5 * share);
        for (const BoneMeasures& bone : Measure(made.Motion(), table).bones)
        {
            const bool isTurned = RowOf(profile, bone.target).kind == ESuggestedRow::Turned;
            EXPECT_TRUE(!bone.measured || !isTurned || bone.largestError < 1.0 + share) << bone.target;
        }
    }
}

TEST(SuggestProfile, ATPoseThatLooksAlongZNeedsNoTurns)
{
    const CMadeSkeleton made("metres", 1);
    const auto target = LoadTarget();
    const SuggestedProfile profile = SuggestProfile(made.Root(), *target->motionRoot);
    const auto result = Convert(CMadeSkeleton("metres rest", 1).Motion(), profile.Table());
    // Every bone is nearly as in the target's own rest pose, including its twist.
    result->motionRoot->UpdateTransform(0.0f);
    const auto rest = LoadTarget();
    for (const char* name : {"UpperTorso", "Head", "LUpperArm", "LForearm", "LHand", "RUpperArm", "RHand"})
    {
        const Mat3 turn = NormalizedRows(FindBone(result->motionRoot.Get(), name)->m_kWorldMatrix);
        rest->motionRoot->UpdateTransform(0.0f);
        const Mat3 own = NormalizedRows(FindBone(rest->motionRoot.Get(), name)->m_kWorldMatrix);
        for (int row = 0; row < 3; ++row)
            EXPECT_GT(Vec3Dot(turn.Row(row), own.Row(row)), 0.96) << name;
    }
}

TEST(SuggestProfile, RowsGoWithWhatTheSkeletonHas)
{
    const std::tuple<const char*, const char*, ESuggestedRow> rows[] = {
        {"spine1", "Waist", ESuggestedRow::NoSource},
        {"spine2", "Waist", ESuggestedRow::Turned},
        {"neck0", "Neck", ESuggestedRow::NoSource},
        {"noclavicle", "LCollar", ESuggestedRow::NoSource},
        {"", "LPelvis", ESuggestedRow::Fixed},
        {"", "LThigh", ESuggestedRow::Neutral},
        {"", "RCalf", ESuggestedRow::Neutral},
        {"", "LFoot", ESuggestedRow::Turned},
        {"nofeet walk", "LFoot", ESuggestedRow::NoSource},
    };
    const auto target = LoadTarget();
    for (const auto& [recipe, bone, kind] : rows)
    {
        const CMadeSkeleton made(recipe, 1);
        const SuggestedProfile profile = SuggestProfile(made.Root(), *target->motionRoot);
        EXPECT_EQ(RowOf(profile, bone).kind, kind) << recipe << ", " << bone;
        const bool hasRow = profile.Table().FindTarget(bone) != CMapRowTable::kNone;
        EXPECT_EQ(hasRow, kind <= ESuggestedRow::Fixed) << recipe << ", " << bone;
    }
}

TEST(SuggestProfile, SaysWhatItIsUnsureOf)
{
    const auto target = LoadTarget();
    const SuggestedProfile byShape = SuggestProfile(CMadeSkeleton("", 1).Root(), *target->motionRoot);
    EXPECT_EQ(RowOf(byShape, "LThigh").sureness, ERowSureness::Likely);
    const SuggestedProfile guessed =
        SuggestProfile(CMadeSkeleton("notoes bare", 1).Root(), *target->motionRoot);
    EXPECT_FALSE(guessed.sidesAreSure);
    EXPECT_EQ(RowOf(guessed, "LThigh").sureness, ERowSureness::Unsure);
    EXPECT_EQ(RowOf(guessed, "Head").sureness, ERowSureness::Likely);
}

TEST(SuggestProfile, NamesThatAProfileCannotHoldAreLeftOut)
{
    const auto target = LoadTarget();
    for (const char* name : {"upper arm", "", "*arm", "Hips"})
    {
        SCOPED_TRACE(name);
        const CMadeSkeleton made("", 1);
        made.Root().SetName("Hips"); // otherwise the last name would be used for the hip
        const BodyPlace place{EBodyJoint::UpperArm, EBodySide::Right};
        JointAt(made.Body(), place)->SetName(name);
        const SuggestedProfile profile = SuggestProfile(made.Root(), *target->motionRoot);
        EXPECT_EQ(RowOf(profile, "RUpperArm").kind, ESuggestedRow::NoName);
        EXPECT_EQ(profile.missing, std::vector<BodyPlace>{place});
    }
}

TEST(NearestOffset, HoldsTheAxisToLessThanADegree)
{
    std::mt19937 random(5);
    std::uniform_real_distribution<float> angle(-3.1f, 3.1f);
    double mean = 0.0;
    for (int i = 0; i < 500; ++i)
    {
        const Mat3 rotation = Mat3FromAxisAngle(kVec3UnitX, angle(random)) *
                              Mat3FromAxisAngle(kVec3UnitY, angle(random)) *
                              Mat3FromAxisAngle(kVec3UnitZ, angle(random));
        const RowNumbers numbers = NearestOffset(rotation, kVec3UnitY);
        const Mat3 offset = OffsetOf(numbers);
        mean += AngleBetween(offset.Row(1), rotation.Row(1)) / 500.0;
        EXPECT_GT(Vec3Dot(offset.Row(1), rotation.Row(1)), std::cos(0.75f * kDegreesToRadians));
        EXPECT_GT(Vec3Dot(offset.Row(0), rotation.Row(0)), std::cos(2.5f * kDegreesToRadians));
        // Axis codes represent the quarter turns, so the remaining angles are small.
        for (const int degrees : numbers.rotation)
            EXPECT_LE(std::abs(degrees), 65);
    }
    EXPECT_LT(mean, 0.31) << "of all whole degrees around, the nearest";
}

TEST(SuggestedName, IsReadable)
{
    EXPECT_EQ(SuggestedName("walk_01"), "walk 01");
    EXPECT_EQ(SuggestedName(""), "Suggested");
    EXPECT_EQ(SuggestedName("__"), "Suggested");
    EXPECT_EQ(SuggestedName("a\nb"), "a b");
    EXPECT_EQ(SuggestedName(std::string(300, 'x')).size(), 64u);
}

} // namespace
} // namespace gw
