// What a faithful conversion promises, of a source whose feet, knees and hips are known.

#include "Angles.h"
#include "CFaithfulLeg.h"
#include "CKeyframeControl.h"
#include "CLegTrack.h"
#include "CSourceBody.h"
#include "CStandPlan.h"
#include "CWalker.h"
#include "Directions.h"
#include "Rotations.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr float kScale = 705.0f / 82.0f;
constexpr const char* kSides[] = {"L", "R"};

class Faithful : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_kTarget = MakeTarget();
        PairWalker(m_kRetargeter, m_kWalker, *m_kTarget);
        m_kRetargeter.SetFaithful(true);
    }
    void Convert(int frameCount, const std::function<CWalker::Pose(int)>& pose, bool useLegs = true)
    {
        m_kWalker.Record(frameCount, pose);
        Run(frameCount, useLegs);
    }
    void Run(int frameCount, bool useLegs = true)
    {
        m_kRetargeter.Retarget(0.0f, static_cast<float>(frameCount - 1), 0.0f, kWalkerSeconds, kTargetOrigin,
                               true, useLegs);
    }
    void PoseAt(int frame)
    {
        const float time = static_cast<float>(frame) / kWalkerSeconds;
        m_kWalker.Root().UpdateScene(time, true);
        m_kTarget->UpdateScene(time, true);
    }
    CNode& Target(const std::string& name) { return *FindNode(m_kTarget.Get(), name.c_str()); }
    Vec3 Place(const std::string& name) { return Target(name).m_kWorldMatrix.Translation(); }
    Vec3 Source(const std::string& name) { return m_kWalker.Bone(name).m_kWorldMatrix.Translation(); }
    Vec3 Along(const std::string& from, const std::string& to) { return Place(to) - Place(from); }
    // Expects a leg's bones to point as the source's, to within these degrees.
    void ExpectLeg(const std::string& side, double thigh, double calf)
    {
        const Vec3 knee = Source(side + "Knee");
        EXPECT_LT(AngleBetween(Along(side + "Thigh", side + "Calf"), knee - Source(side + "Hip")), thigh);
        EXPECT_LT(AngleBetween(Along(side + "Calf", side + "Foot"), Source(side + "Ankle") - knee), calf);
    }
    double KneeAngle(const std::string& side)
    {
        return AngleBetween(Along(side + "Thigh", side + "Calf"), Along(side + "Calf", side + "Foot"));
    }
    std::vector<Quat> Rotations(const std::string& name)
    {
        return static_cast<CKeyframeControl*>(Target(name).GetControl())->m_kRotationKeys;
    }

    CWalker m_kWalker;
    Ref<CNode> m_kTarget;
    CRetargeter m_kRetargeter;
};

TEST_F(Faithful, FeetOfAWalkStandStillOnTheFloorAndLegsPointAsTheSources)
{
    constexpr int kFrames = 120;
    Convert(kFrames, WalkingPose);
    for (int side = 0; side < 2; ++side)
    {
        const std::string name = kSides[side];
        Vec3 held = kVec3Zero;
        for (int frame = 1; frame < kFrames; ++frame)
        {
            SCOPED_TRACE(name + " frame " + std::to_string(frame));
            PoseAt(frame);
            ExpectLeg(name, 2.5, 2.5);
            EXPECT_GT(std::min(Place(name + "Foot").y - 80.0f, Place(name + "Toe").y - 18.0f), -50.0f);
            if (!WalkerStands(side, frame))
                continue;
            if (!WalkerStands(side, frame - 1))
                held = Place(name + "Foot");
            EXPECT_LT(Vec3Length(Place(name + "Foot") - held), 1.5) << "stands";
            EXPECT_NEAR(Place(name + "Foot").y, 80.0f, 3.0f) << "on the floor";
            EXPECT_NEAR(Place(name + "Toe").y, 18.0f, 3.0f) << "on the floor";
        }
    }
}

TEST_F(Faithful, RootGoesAsFarAndHipsAreAsHighAsTheSourcesInLegLengths)
{
    const auto crouching = [](int frame) {
        CWalker::Pose pose;
        pose.hips = {0.05f * static_cast<float>(frame),
                     84.0f - 20.0f * static_cast<float>(std::sin(kPi64 * frame / 60.0)), 0.0f};
        pose.lean = 0.6f * static_cast<float>(frame);
        return pose;
    };
    Convert(61, crouching, false);
    PoseAt(0);
    EXPECT_NEAR(Place("LowerTorso").x, kTargetOrigin.x, 1e-3f);
    EXPECT_NEAR(Place("LowerTorso").z, kTargetOrigin.z, 1e-3f);
    const float start = (Place("LThigh") + Place("RThigh")).y * 0.5f;
    EXPECT_NEAR(start - 80.0f, 76.0f * kScale, 15.0f);
    for (int frame = 0; frame <= 60; frame += 10)
    {
        SCOPED_TRACE(frame);
        PoseAt(frame);
        const float height = (Place("LThigh") + Place("RThigh")).y * 0.5f;
        EXPECT_NEAR(height - start, (crouching(frame).hips.y - 84.0f) * kScale, 0.1f);
        EXPECT_NEAR(Place("LowerTorso").x, crouching(frame).hips.x * kScale, 0.1f);
    }
}

TEST_F(Faithful, KneesBendInTheSourcesPlaneAndFeetKeepTheirTurn)
{
    const auto squatting = [](int frame) {
        CWalker::Pose pose = WalkingPose(frame);
        pose.hips.y -= 12.0f;
        pose.kneesOut = 60.0f * static_cast<float>(std::sin(0.2 * frame));
        pose.lean = 20.0f;
        return pose;
    };
    Convert(72, squatting);
    const Mat3 halfTurn = Mat3FromAxisAngle(kVec3UnitZ, kPi);
    for (int frame = 0; frame < 72; frame += 5)
    {
        SCOPED_TRACE(frame);
        PoseAt(frame);
        for (const std::string side : kSides)
        {
            ExpectLeg(side, 4.0, 6.0);
            const Mat3 turned = halfTurn * NormalizedRows(m_kWalker.Bone(side + "Ankle").m_kWorldMatrix);
            EXPECT_LT(DegreesBetween(NormalizedRows(Target(side + "Foot").m_kWorldMatrix), turned), 2.0);
        }
    }
}

// As sensors drift that have no floor to tell them.
TEST_F(Faithful, StandingFeetOfABodyThatRisesStayOnTheFloorAndItsKneesAsTheyAre)
{
    const auto rising = [](int frame) {
        CWalker::Pose pose;
        for (Vec3* place : {&pose.hips, &pose.ankles[0], &pose.ankles[1]})
            place->y += 0.025f * static_cast<float>(frame);
        return pose;
    };
    Convert(120, rising);
    for (int frame = 0; frame < 120; frame += 17)
    {
        SCOPED_TRACE(frame);
        PoseAt(frame);
        ExpectLeg("L", 1.5, 1.5);
        EXPECT_NEAR(Place("LFoot").y, 80.0f, 2.0f);
    }
}

// A straight leg's knee turns by degrees where its reach differs by a millimetre, as under a foot that rocks.
TEST_F(Faithful, NearlyStraightLegsOfANoisySourceDoNotJerk)
{
    const auto rocking = [](int frame) {
        CWalker::Pose pose;
        pose.hips.y = 89.95f;
        pose.footDegrees = {frame % 2 == 0 ? 0.0f : 1.2f, 0.0f};
        return pose;
    };
    Convert(60, rocking);
    PoseAt(0);
    double before = KneeAngle("L");
    for (int frame = 1; frame < 60; ++frame)
    {
        PoseAt(frame);
        const double angle = KneeAngle("L");
        EXPECT_LT(std::fabs(angle - before), 4.0) << frame;
        before = angle;
    }
}

TEST_F(Faithful, WithoutHeldFeetLegsPointExactlyAsTheSources)
{
    Convert(40, WalkingPose, false);
    for (int frame = 0; frame < 40; frame += 3)
    {
        PoseAt(frame);
        ExpectLeg("L", 0.05, 0.05);
    }
}

TEST_F(Faithful, LegThatIsNotMappedToItsFootIsLeftToTheRules)
{
    m_kRetargeter.SetSourceOf(&Target("RFoot"), nullptr);
    Convert(40, WalkingPose);
    const std::vector<Quat> thigh = Rotations("RThigh");
    const std::vector<Quat> left = Rotations("LThigh");
    m_kTarget = MakeTarget();
    CRetargeter plain;
    PairWalker(plain, m_kWalker, *m_kTarget);
    plain.SetSourceOf(&Target("RFoot"), nullptr);
    plain.Retarget(0.0f, 39.0f, 0.0f, kWalkerSeconds, kTargetOrigin, true, true);
    EXPECT_EQ(thigh, Rotations("RThigh"));
    EXPECT_NE(left, Rotations("LThigh"));
}

TEST_F(Faithful, OddSourcesGiveFiniteKeys)
{
    // drop: of the left ankle below its hip; place: of all joints, in x; jump: of the root in the last frame,
    // in z
    const std::tuple<const char*, int, float, float, float> rows[] = {
        {"one frame", 1, 76.0f, 0.0f, 0.0f},
        {"an ankle at its hip", 20, 2.5f, 0.0f, 0.0f},
        {"far away", 20, 76.0f, 1e7f, 0.0f},
        {"at the end of the numbers", 20, 76.0f, 0.0f, 3.4e38f},
    };
    for (const auto& [what, frameCount, drop, place, jump] : rows)
    {
        SCOPED_TRACE(what);
        CWalker walker;
        walker.Record(frameCount, [drop = drop, place = place](int frame) {
            CWalker::Pose pose = WalkingPose(frame);
            pose.ankles[0] = pose.hips + Vec3{9.0f, -drop, 0.0f};
            for (Vec3* joint : {&pose.hips, &pose.ankles[0], &pose.ankles[1]})
                joint->x += place;
            return pose;
        });
        static_cast<CKeyframeControl*>(walker.Root().GetControl())->m_kPositionKeys.Expand().back().z += jump;
        m_kTarget = MakeTarget();
        PairWalker(m_kRetargeter, walker, *m_kTarget);
        Run(frameCount);
        for (const CNode* node : NodesOf(*m_kTarget))
        {
            ASSERT_EQ(Rotations(node->GetName()).size(), static_cast<size_t>(frameCount));
            for (const Quat& key : Rotations(node->GetName()))
                ASSERT_TRUE(std::isfinite(key.w + key.x + key.y + key.z)) << node->GetName();
        }
    }
}

TEST_F(Faithful, FeetOfASinglePoseStandOnTheFloor)
{
    Convert(1, [](int) {
        CWalker::Pose pose;
        pose.ankles[1] = {-9.0f, 30.0f, 20.0f}; // a step up
        return pose;
    });
    PoseAt(0);
    EXPECT_NEAR(Place("LFoot").y, 80.0f, 1.0f);
    EXPECT_NEAR(Place("RFoot").y, 80.0f + 22.0f * kScale, 12.0f);
}

// Feet stand still, and a hand hangs far below them, as over the edge of a stage.
TEST_F(Faithful, StandingBodyIsNotLiftedByAHandBelowItsFeet)
{
    m_kWalker.Record(20, [](int) { return CWalker::Pose(); });
    CPoseMatcher matcher(m_kRetargeter, *m_kTarget);
    std::vector<CFaithfulLeg> legs;
    for (const std::string side : kSides)
        legs.push_back(*CFaithfulLeg::Plan(
            m_kRetargeter, matcher,
            {&Target(side + "Thigh"), &Target(side + "Calf"), &Target(side + "Foot"), &Target(side + "Toe")},
            0.0));
    CSourceBody source(&m_kWalker.Root(), {legs[0].Source(), legs[1].Source()});
    for (int frame = 0; frame < 20; ++frame)
    {
        PoseAt(frame);
        matcher.MatchPose();
        source.Append();
        for (CFaithfulLeg& leg : legs)
        {
            leg.AppendSource();
            leg.ReadTarget(matcher, static_cast<size_t>(frame), {});
        }
    }
    source.FindTouches(kWalkerSeconds);
    const auto plan = [&](float lowestHand) {
        return CStandPlan(legs, source, lowestHand, kTargetOrigin, kWalkerSeconds, false);
    };
    EXPECT_EQ(plan(-60.0f).Root(10), plan(80.0f).Root(10));
    EXPECT_NEAR(plan(-60.0f).OnTarget({}).y, 0.0f, 12.0f) << "and its own floor stays the floor";
}

// The lower joint of a foot is 4 below the origin at rest, half a calf is 18.5 long.
TEST(RestFloor, IsTheOriginsForABodyThatStandsAndElseItsOwn)
{
    const CWalker walker;
    const std::vector<LegJoints> legs{
        {&walker.Bone("LHip"), &walker.Bone("LKnee"), &walker.Bone("LAnkle"), &walker.Bone("LBall")}};
    for (const auto& [raised, floor] : {std::pair{0.0f, -4.0}, {6.0f, 0.0}, {36.0f, 32.0}})
    {
        walker.Root().m_kMatrix.SetTranslation({0.0f, 88.0f + raised, 0.0f});
        EXPECT_NEAR(RestFloor(legs), floor, 1e-4) << raised;
    }
}

} // namespace
} // namespace gw
