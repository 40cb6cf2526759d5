// Conversions checked by geometry: poses are rebuilt from the tracks that came out and compared with what the
// source shows, never with numbers that the program once gave.

#include "CKeyframeControl.h"
#include "CPoseMatcher.h"
#include "CTriMesh.h"
#include "CWalker.h"
#include "Euler.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TempFolder.h"

#include <cmath>
#include <gtest/gtest.h>
#include <random>
#include <string>
#include <tuple>

namespace gw {
namespace {

constexpr float kFrequency = 1.0f / 30.0f;

// A source of other proportions and units, every joint's axes along the world's at rest.
constexpr MadeBone kSource[] = {
    {"Hips", "", {0, 92, 0}},
    {"Spine", "Hips", {0, 12, 0}},
    {"Spine1", "Spine", {0, 11, 0}},
    {"Chest", "Spine1", {0, 14, 0}},
    {"Neck", "Chest", {0, 26, 1}},
    {"LeftCollar", "Chest", {3, 22, 0}},
    {"LeftArm", "LeftCollar", {14, 0, 0}},
    {"LeftElbow", "LeftArm", {28, 0, 0}},
    {"LeftWrist", "LeftElbow", {25, 0, 0}},
    {"LeftHip", "Hips", {9, -4, 0}},
    {"LeftKnee", "LeftHip", {0, -43, 0}},
    {"LeftAnkle", "LeftKnee", {0, -40, 0}},
    {"RightHip", "Hips", {-9, -4, 0}},
    {"RightKnee", "RightHip", {0, -43, 0}},
    {"RightAnkle", "RightKnee", {0, -40, 0}},
};

CKeyframeControl& TrackOf(CNode& node)
{
    return *RecordCast<CKeyframeControl>(node.GetControl());
}

// A source whose bones turn at random but moderately, and whose root has a path.
Ref<CNode> MakeSource(int frameCount)
{
    std::mt19937 random(11);
    std::uniform_real_distribution<float> angle(-25.0f, 25.0f);
    CMadeFigure figure(kSource);
    const auto move = [&](CMadeFigure&, int frame) {
        const float step = 3.0f * static_cast<float>(frame);
        for (CNode* node : NodesOf(figure.Root()))
            node->m_kMatrix = Mat4Compose(EulerToMat3("ZXY", {angle(random), angle(random), angle(random)}),
                                          node->m_kMatrix.Translation());
        figure.Move("Hips", {0.2f * step, -0.1f * step, step});
    };
    figure.Record(frameCount, move, kFrequency);
    return &figure.Root();
}

const std::pair<const char*, const char*> kMap[] = {
    // source and target
    {"Hips", "LowerTorso"},   {"Chest", "UpperTorso"},   {"Neck", "Neck"},       {"LeftCollar", "LCollar"},
    {"LeftArm", "LUpperArm"}, {"LeftElbow", "LForearm"}, {"LeftWrist", "LHand"}, {"LeftHip", "LThigh"},
    {"RightHip", "RThigh"},   {"LeftKnee", "LCalf"},     {"RightKnee", "RCalf"}, {"LeftAnkle", "LFoot"},
    {"RightAnkle", "RFoot"},
};

class CRetargeterTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_kSource = MakeSource(10);
        m_kTarget = MakeTarget();
        m_kRetargeter.SetScenes(m_kSource.Get(), m_kTarget.Get());
        for (const auto& [source, target] : kMap)
            m_kRetargeter.SetSourceOf(Target(target), Source(source));
        m_kRetargeter.SetFixed(Target("LPelvis"), true);
        m_kRetargeter.SetFixed(Target("RPelvis"), true);
        // Arms stand a quarter turn away, where the default decomposition has its flipped end.
        for (const char* arm : {"LCollar", "LUpperArm", "LForearm", "LHand"})
            m_kRetargeter.SetShares(Target(arm), {1, 1, 2});
    }
    CNode* Source(const char* name) { return FindNode(m_kSource.Get(), name); }
    CNode* Target(const char* name) { return FindNode(m_kTarget.Get(), name); }
    bool Run(bool useLegs = true, float last = 9.0f)
    {
        return m_kRetargeter.Retarget(0, last, 0, kFrequency, kTargetOrigin, true, useLegs);
    }
    void Pose(size_t frame)
    {
        m_kSource->UpdateScene(static_cast<float>(frame) / kFrequency, true);
        m_kTarget->UpdateScene(static_cast<float>(frame) / kFrequency, true);
    }
    double DegreesToSource(const char* bone, const char* source, const Mat3& offset = kMat3Identity)
    {
        return DegreesBetween(NormalizedRows(Target(bone)->m_kWorldMatrix),
                              offset * NormalizedRows(Source(source)->m_kWorldMatrix));
    }
    // The target's size against that of the source at rest.
    float Scale()
    {
        for (CNode* node : NodesOf(*m_kSource))
            TrackOf(*node).m_bActive = false;
        m_kSource->UpdateScene(0, true);
        m_kTarget->UpdateScene(0, true);
        float scale = 0.0f;
        float rise = 0.0f;
        m_kRetargeter.MeasureBody(scale, rise, 0.45f);
        for (CNode* node : NodesOf(*m_kSource))
            TrackOf(*node).m_bActive = true;
        return scale;
    }

    Ref<CNode> m_kSource;
    Ref<CNode> m_kTarget;
    CRetargeter m_kRetargeter;
};

TEST_F(CRetargeterTest, MappedBonesTakeTheWorldRotationOfTheirSourceUpToOffsets)
{
    const Mat3 codes{{-1, 0, 0, 0, 0, 1, 0, 1, 0}};
    m_kRetargeter.SetOffsetAngles(Target("LForearm"), {12, -30, 45});
    m_kRetargeter.SetOffsetMatrix(Target("LForearm"), codes);
    m_kRetargeter.SetOffsetAngles(Target("Neck"), {0, 90, 0});
    ASSERT_TRUE(Run(false));
    // An offset stands left of the source's rotation: it acts first.
    std::map<std::string_view, Mat3> offsets;
    offsets["Neck"] = EulerToMat3("ZYX", {0, 90, 0});
    offsets["LForearm"] = codes * EulerToMat3("ZYX", {12, 0, 0}) * EulerToMat3("ZYX", {0, -30, 0}) *
                          EulerToMat3("ZYX", {0, 0, 45});
    for (size_t frame = 0; frame < 10; ++frame)
    {
        Pose(frame);
        for (const auto& [from, bone] : kMap)
        {
            const Mat3 offset = offsets.contains(bone) ? offsets[bone] : kMat3Identity;
            EXPECT_LT(DegreesToSource(bone, from, offset), 0.05) << bone << " in frame " << frame;
        }
    }
}

// Two bones take a turn about one axis: the first of the three that it is taken apart into goes by the sine
// of a share, the last by the other share, as quaternions that are not normalised on the way. The degrees
// were worked out apart from the program, in the plane of the turn.
TEST_F(CRetargeterTest, SharesAreInProportionToTheirWeights)
{
    const std::tuple<BoneShares, Vec3, double> rows[] = {
        {{1, 1, 1}, {40, 0, 0}, 20.0},   {{3, 1, 1}, {40, 0, 0}, 30.868}, {{1, 3, 1}, {40, 0, 0}, 20.0},
        {{0, 0, 1}, {40, 0, 0}, 0.0},    {{1, 1, 1}, {0, 40, 0}, 23.681}, {{3, 1, 1}, {0, 40, 0}, 22.197},
        {{1, 3, 1}, {0, 40, 0}, 35.369},
    };
    for (CNode* node : NodesOf(*m_kSource))
        TrackOf(*node).m_kRotationKeys.assign(10, kQuatIdentity);
    for (const auto& [shares, turn, degrees] : rows)
    {
        TrackOf(*Source("Chest")).m_kRotationKeys.assign(10, QuatFromMat3(EulerToMat3("ZYX", turn)));
        m_kRetargeter.SetShares(Target("Waist"), shares);
        m_kRetargeter.SetShares(Target("UpperTorso"), {1, 1, 1});
        ASSERT_TRUE(Run(false));
        Pose(4);
        EXPECT_NEAR(DegreesBetween(NormalizedRows(Target("Waist")->m_kMatrix), kMat3Identity), degrees, 0.002)
            << shares.m_fShare1 << ' ' << shares.m_fShare2 << ' ' << turn.y;
    }
}

TEST_F(CRetargeterTest, BonesWithoutWeightTakeTheWholeTurnAndFixedOnesNone)
{
    ASSERT_TRUE(Run(false));
    Pose(4);
    EXPECT_LT(DegreesToSource("Waist", "Chest"), 0.05);
    m_kRetargeter.SetFixed(Target("Waist"), true);
    ASSERT_TRUE(Run(false));
    Pose(4);
    EXPECT_LT(DegreesBetween(NormalizedRows(Target("Waist")->m_kMatrix), kMat3Identity), 1e-3);
    EXPECT_LT(DegreesToSource("UpperTorso", "Chest"), 0.05);
}

TEST_F(CRetargeterTest, FeetReachTheScaledGoalsOfTheSource)
{
    ASSERT_TRUE(Run());
    const float scale = Scale();
    int reached = 0;
    for (size_t frame = 0; frame < 10; ++frame)
    {
        Pose(frame);
        const Vec3 sourceHip = Source("Hips")->m_kWorldMatrix.Translation();
        const Vec3 targetHip = Target("LowerTorso")->m_kWorldMatrix.Translation();
        for (const auto& [source, target, thigh] :
             {std::tuple{"LeftAnkle", "LFoot", "LThigh"}, std::tuple{"RightAnkle", "RFoot", "RThigh"}})
        {
            const Vec3 goal = targetHip + (Source(source)->m_kWorldMatrix.Translation() - sourceHip) * scale;
            const Vec3 fromHip = goal - Target(thigh)->m_kWorldMatrix.Translation();
            if (Vec3Length(fromHip) > 704.9)
                continue; // drawn in: nearer than the goal by intent
            ++reached;
            EXPECT_LT(Vec3Length(Target(target)->m_kWorldMatrix.Translation() - goal), 0.05)
                << target << " in frame " << frame;
        }
    }
    EXPECT_GT(reached, 10);
}

TEST_F(CRetargeterTest, LegsChangeThighsAndCalvesAndNothingElse)
{
    ASSERT_TRUE(Run(false));
    std::map<std::string, std::vector<Quat>> without;
    for (CNode* node : NodesOf(*m_kTarget))
        without[node->GetName()] = TrackOf(*node).m_kRotationKeys;
    ASSERT_TRUE(Run(true));
    for (CNode* node : NodesOf(*m_kTarget))
    {
        const std::string name = node->GetName();
        const bool isLeg = name.ends_with("Thigh") || name.ends_with("Calf");
        EXPECT_EQ(TrackOf(*node).m_kRotationKeys != without[name], isLeg) << name;
    }
}

TEST_F(CRetargeterTest, TheRootStartsAtTheRootPositionAndFollowsTheScaledHip)
{
    ASSERT_TRUE(Run());
    const CKeyArray<Vec3>& keys = TrackOf(*m_kTarget).m_kPositionKeys;
    ASSERT_EQ(keys.size(), 10u);
    EXPECT_EQ(keys[0], kTargetOrigin);
    const Vec3 step = keys[1] - keys[0];
    EXPECT_NEAR(step.x / step.z, 0.2, 1e-3);
    EXPECT_NEAR(step.y / step.z, -0.1, 1e-3);
    EXPECT_NEAR(Vec3Length(keys[9] - keys[0]) / Vec3Length(step), 9.0, 1e-3);
}

// The left thigh stands 138 below the root, and its mesh reaches 10 below that.
TEST_F(CRetargeterTest, WithoutAResetTheRootStandsOnTheGroundBesideTheRootPosition)
{
    CTriMesh* const mesh = new CTriMesh;
    ASSERT_TRUE(mesh->SetPointCount(2));
    mesh->XYZBuffer()[0] = {0, -10, 0};
    mesh->XYZBuffer()[1] = {0, 50, 0};
    Target("LThigh")->AttachChild(mesh);
    ASSERT_TRUE(m_kRetargeter.Retarget(0, 9, 0, kFrequency, {5, 7, 11}, false, false));
    const Vec3 first = TrackOf(*m_kTarget).m_kPositionKeys[0];
    EXPECT_LT(Vec3Length(first - Vec3{5, 7 + 138 + 10, 11}), 0.01) << first.y;
}

TEST_F(CRetargeterTest, TracksHaveAKeyForEveryFrameThroughTheLast)
{
    const std::tuple<const char*, float, size_t> rows[] = {
        {"ten frames", 9.0f, 10},
        {"the last one counts only when it is reached", 4.5f, 5},
        {"one frame", 0.0f, 1},
        {"none below 0", -1.0f, 0},
        {"more than memory holds", 1e6f, 0},
        {"without end", INFINITY, 0},
    };
    for (const auto& [what, last, keys] : rows)
    {
        SCOPED_TRACE(what);
        ASSERT_TRUE(Run(true, last));
        EXPECT_EQ(m_kRetargeter.Record().Failure().reason,
                  last >= 1e6f ? EFailure::TooLarge : EFailure::None);
        for (CNode* node : NodesOf(*m_kTarget))
        {
            const CKeyframeControl& track = TrackOf(*node);
            EXPECT_EQ(track.m_kKeyTimes.size(), keys);
            EXPECT_EQ(track.m_kRotationKeys.size(), keys);
            EXPECT_EQ(track.m_kPositionKeys.size(), keys);
            EXPECT_EQ(track.m_kScaleKeys.size(), keys);
            EXPECT_EQ(node->GetControl()->GetNext(), nullptr) << "tracks of an earlier run";
        }
    }
}

TEST_F(CRetargeterTest, RestScalesSurviveAScaledSource)
{
    for (CNode* node : NodesOf(*m_kSource))
    {
        CKeyArray<Vec3>& scales = TrackOf(*node).m_kScaleKeys;
        scales.assign(scales.size(), {1.5f, 1.5f, 1.5f});
    }
    Target("LForearm")->m_kMatrix = Mat4Compose(kMat3Identity, {0, 285, 0}, {1.0f, 1.2f, 1.0f});
    ASSERT_TRUE(Run(false));
    for (CNode* node : NodesOf(*m_kTarget))
    {
        const Vec3 wanted = node == Target("LForearm") ? Vec3{1.0f, 1.2f, 1.0f} : kVec3One;
        EXPECT_LT(Vec3Length(TrackOf(*node).m_kScaleKeys[5] - wanted), 1e-5) << node->GetName();
    }
}

TEST_F(CRetargeterTest, ASourceOfTwiceTheSizeHasHalfTheScale)
{
    const float once = Scale();
    // Legs of 705 over a drop of 138 against legs of 83 over a drop of 4, bent by almost nothing.
    EXPECT_NEAR(once, (705.0 + 138.0) / (83.0 + 4.0), 0.01);
    for (CNode* node : NodesOf(*m_kSource))
        TrackOf(*node).m_kRestMatrix.SetTranslation(TrackOf(*node).m_kRestMatrix.Translation() * 2.0f);
    EXPECT_NEAR(Scale(), once / 2.0f, 1e-4);
}

TEST_F(CRetargeterTest, ShareFileLines)
{
    // bone: null where none gets shares
    const std::tuple<const char*, std::string, const char*, BoneShares> rows[] = {
        {"plain", "Waist Share 1 2 Type 0", "Waist", {1, 2, 0}},
        {"keywords without case, commas and colons", "SHARE: 3, 4, tYPE: 2, Neck", "Neck", {3, 4, 2}},
        {"type stays from the line before", "Type 2 Waist\nUpperTorso Share 1 5", "UpperTorso", {1, 5, 2}},
        {"the last name wins", "Waist Neck Share 6 7 Type 1", "Neck", {6, 7, 1}},
        {"a signed number is a name", "Neck Share -1 2 Type 1", nullptr, {}},
        {"a name in another case", "wAIST Share 3 1 Type 2", "Waist", {3, 1, 2}},
        {"a bone that is not there", "Tail Share 1 1 Type 1", nullptr, {}},
        {"no numbers", "Neck Share Type", nullptr, {}},
        {"a line goes on as another behind 1023 bytes",
         std::string("Waist Share 1 2 Type 0").append(1001, ' ') + "Neck Type 2",
         "Neck",
         {1, 2, 2}},
        {"windows line ends", "Waist Share 8 9 Type 1\r\n", "Waist", {8, 9, 1}},
    };
    const CTempFolder folder;
    const std::string path = folder.Path("shares.bsm");
    for (const auto& [what, line, bone, weights] : rows)
    {
        SCOPED_TRACE(what);
        WriteBytes(path, line);
        CRetargeter retargeter;
        retargeter.SetScenes(m_kSource.Get(), m_kTarget.Get());
        ASSERT_TRUE(retargeter.LoadShares(path));
        const BoneShares* shares = nullptr;
        ASSERT_EQ(retargeter.Shares(Target(bone ? bone : "Neck"), shares), bone != nullptr);
        if (!bone)
            continue;
        EXPECT_EQ(std::tuple(shares->m_fShare1, shares->m_fShare2, shares->m_fType),
                  std::tuple(weights.m_fShare1, weights.m_fShare2, weights.m_fType));
    }
    EXPECT_FALSE(m_kRetargeter.LoadShares(folder.Path("none.bsm")));
}

TEST(CPoseMatcher, ChildrenStayWhenALocalMatrixIsSet)
{
    const Ref<CNode> target = MakeTarget();
    CNode& torso = *FindNode(target.Get(), "UpperTorso");
    target->UpdateScene(0.0f, true);
    const Mat4 hand = FindNode(target.Get(), "LHand")->m_kWorldMatrix;
    const Mat4 local = Mat4Compose(EulerToMat3("ZYX", {10, 20, 30}), {1, 2, 3}, {2, 2, 2});
    SetLocalMatrixKeepChildren(torso, local);
    target->UpdateScene(0.0f, true);
    EXPECT_EQ(torso.m_kMatrix, local);
    ExpectNear(FindNode(target.Get(), "LHand")->m_kWorldMatrix, hand, 1e-3);
}

} // namespace
} // namespace gw
