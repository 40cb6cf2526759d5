// A trunk that leans as the source's whatever its proportions, and hands that keep their gaps.

#include "CFaithfulArm.h"
#include "CHandPlan.h"
#include "CKeyframeControl.h"
#include "CTrunkAim.h"
#include "CWalker.h"
#include "Directions.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

// A source with hip joints ahead of its spine, a short small of the back and a long chest.
constexpr MadeBone kSource[] = {
    {"Hips", "", {0.0f, 90.0f, 0.0f}},       {"LHip", "Hips", {9.0f, -6.0f, 3.0f}},
    {"RHip", "Hips", {-9.0f, -6.0f, 3.0f}},  {"Spine", "Hips", {0.0f, 8.0f, -1.0f}},
    {"Chest", "Spine", {0.0f, 8.0f, 0.0f}},  {"Throat", "Chest", {0.0f, 34.0f, 0.0f}},
    {"Skull", "Throat", {0.0f, 9.0f, 0.0f}},
};

// At rest, with its world matrices.
Ref<CNode> Standing(const Ref<CNode>& root)
{
    root->UpdateScene(0.0f, true);
    return root;
}

Vec3 Place(CNode& root, const char* name)
{
    return FindNode(&root, name)->m_kWorldMatrix.Translation();
}

Vec3 Chord(CNode& root, const char* left, const char* right, const char* neck)
{
    return Place(root, neck) - (Place(root, left) + Place(root, right)) * 0.5f;
}

// The target's line in the axes of the source's trunk.
Vec3 LineInTrunk(CNode& source, CNode& target)
{
    const Mat3 upright =
        TurnUpright(Chord(source, "LHip", "RHip", "Throat"), Place(source, "LHip") - Place(source, "RHip"));
    return Turned(Chord(target, "LThigh", "RThigh", "Neck"), upright);
}

TEST(CTrunkAim, LineFromHipsToNeckFollowsTheSourcesAsAtRestAndTheHeadKeepsItsTurn)
{
    const Ref<CNode> source = Standing(&CMadeFigure(kSource).Root());
    const Ref<CNode> target = Standing(MakeTarget());
    CRetargeter table;
    table.SetScenes(source.Get(), target.Get());
    for (const auto& [bone, joint] : {std::pair{"LowerTorso", "Hips"},
                                      {"Waist", "Spine"},
                                      {"UpperTorso", "Chest"},
                                      {"Neck", "Throat"},
                                      {"Head", "Skull"},
                                      {"LThigh", "LHip"},
                                      {"RThigh", "RHip"}})
        table.SetSourceOf(FindNode(target.Get(), bone), FindNode(source.Get(), joint));
    CPoseMatcher matcher(table, *target);
    CTrunkAim aim(table, matcher, target.Get());
    const Vec3 rest = LineInTrunk(*source, *target);
    EXPECT_GT(AngleBetween(rest, kVec3UnitY), 3.0); // the source's hip joints are ahead of its neck
    for (const char* joint : {"Hips", "Spine", "Chest", "Throat"}) // a bow, and a turn to the side
    {
        CNode& node = *FindNode(source.Get(), joint);
        node.m_kMatrix = Mat4Compose(TurnAbout(kVec3UnitX, 35.0) * TurnAbout(kVec3UnitY, 10.0),
                                     node.m_kMatrix.Translation());
    }
    source->UpdateScene(0.0f, true);
    matcher.MatchPose();
    const auto head = static_cast<size_t>(matcher.IndexOf(FindNode(target.Get(), "Head")));
    const Mat3 turn = NormalizedRows(matcher.Bones()[head].world);
    aim.Aim(matcher);
    matcher.WriteNodes();
    target->UpdateScene(0.0f, true);
    EXPECT_LT(AngleBetween(LineInTrunk(*source, *target), rest), 0.01);
    EXPECT_LT(AngleOf(Mat3Transpose(turn) * NormalizedRows(FindNode(target.Get(), "Head")->m_kWorldMatrix)),
              0.05);
}

constexpr LegLengths kArm{280.0, 260.0};

// A body that sits with its thighs along z; its hands are far from everything.
ArmPoints Sitting()
{
    ArmPoints body;
    for (size_t side = 0; side < 2; ++side)
    {
        const float x = side == 0 ? 1.0f : -1.0f;
        body.hips[side] = {95.0f * x, 450.0f, 0.0f};
        body.knees[side] = {95.0f * x, 450.0f, 360.0f};
        body.hands[side] = {400.0f * x, 700.0f, 200.0f};
        body.collars[side] = {25.0f * x, 1000.0f, 0.0f};
        body.shoulders[side] = {170.0f * x, 1000.0f, 0.0f};
    }
    body.neck = {0.0f, 1090.0f, 0.0f};
    body.head = {0.0f, 1190.0f, 0.0f};
    return body;
}

Vec3 HandAfter(const ArmPoints& body, size_t side, const ArmTurn& turn)
{
    const Vec3& collar = body.collars[side];
    const Vec3& shoulder = body.shoulders[side];
    return collar + TurnedCollar(shoulder - collar, body.chestUp, turn) +
           TurnedHand(kArm, body.hands[side] - shoulder, turn);
}

// Both bodies keep their poses for so long that the hands of the target have time to get anywhere.
CHandPlan SolvedPlan(const TouchPoints& source, const ArmPoints& target, double secondsPerFrame)
{
    CHandPlan plan({kArm, kArm}, 40, secondsPerFrame, true);
    for (size_t sample = 0; sample < plan.SampleCount(); ++sample)
        plan.Add(sample, source, target);
    plan.Solve();
    return plan;
}

TEST(CHandPlan, HandsKeepTheirGapsAndOthersTheirPaths)
{
    const Vec3 away{-400.0f, 700.0f, 200.0f};
    const Vec3 overThigh{95.0f, 600.0f, 330.0f};
    // hands of the source and the target's left hand; left: the gap of the first one to what it touches
    const std::tuple<const char*, Vec3, Vec3, Vec3, double> rows[] = {
        {"on a thigh", {95.0f, 510.0f, 250.0f}, away, overThigh, 60.0},
        {"in the floor", {400.0f, -30.0f, 250.0f}, away, {170.0f, 160.0f, 100.0f}, 20.0},
        {"that clap", {30.0f, 900.0f, 400.0f}, {-30.0f, 900.0f, 400.0f}, overThigh, 60.0},
        {"at the head", {0.0f, 1297.0f, 90.0f}, away, {60.0f, 1200.0f, 240.0f}, 90.0},
        {"far from it all", {400.0f, 700.0f, 400.0f}, away, overThigh, -1.0},
    };
    for (size_t touched = 0; const auto& [what, leftHand, rightHand, free, left] : rows)
    {
        SCOPED_TRACE(what);
        ArmPoints target = Sitting();
        TouchPoints source = target;
        source.hands = {leftHand, rightHand};
        target.hands = {free, {-60.0f, 700.0f, 330.0f}};
        if (free.y < 200.0f) // bent over
            target.collars[0].y = target.shoulders[0].y = 500.0f;
        for (const double rate : {30.0, 120.0}) // at the second one, most frames lie between samples
        {
            const CHandPlan plan = SolvedPlan(source, target, 1.0 / rate);
            EXPECT_EQ(plan.Touches(source), left >= 0.0);
            const Vec3 hand = HandAfter(target, 0, plan.Turn(0, 19));
            const Vec3 other = HandAfter(target, 1, plan.Turn(1, 19));
            const Vec3 thigh = hand - Vec3{95.0f, 450.0f, std::min(hand.z, 360.0f)};
            const double gaps[] = {Vec3Length(thigh), static_cast<double>(hand.y), Vec3Length(hand - other),
                                   Vec3Length(hand - target.head - Vec3{0.0f, 107.0f, 0.0f})};
            if (left >= 0.0)
                EXPECT_NEAR(gaps[touched], left, 20.0) << "of 120 and more";
            else
                EXPECT_LT(Vec3Length(hand - free), 0.01);
        }
        ++touched;
    }
}

// The straight arm ends above the thigh, where no rotation takes it to the source's gap.
TEST(CHandPlan, ShoulderLowersAHandThatHangsAboveTheThigh)
{
    ArmPoints target = Sitting();
    TouchPoints source = target;
    source.hands[0] = {130.0f, 450.0f, 20.0f};
    target.shoulders[0] = {130.0f, 1090.0f, 0.0f};
    target.collars[0] = {-15.0f, 1090.0f, 0.0f};
    target.hands[0] = {130.0f, 551.0f, 0.0f};
    const CHandPlan plan = SolvedPlan(source, target, 1.0 / 30.0);
    const ArmTurn turn = plan.Turn(0, 20);
    EXPECT_LT(turn.raise, -0.1);
    EXPECT_GT(turn.raise, -0.5);
    EXPECT_LT(Vec3Length(HandAfter(target, 0, turn) - target.hips[0]),
              Vec3Length(target.hands[0] - target.hips[0]) - 15.0);
}

TEST(CFaithfulArm, HandFollowsTheTurnAndTheElbowStaysOnItsSide)
{
    const Ref<CNode> source = Standing(MakeTarget());
    const Ref<CNode> target = Standing(MakeTarget());
    CRetargeter table;
    table.SetScenes(source.Get(), target.Get());
    for (const char* bone : {"LUpperArm", "LForearm", "LHand"})
        table.SetSourceOf(FindNode(target.Get(), bone), FindNode(source.Get(), bone));
    CPoseMatcher matcher(table, *target);
    auto arm = CFaithfulArm::Plan(table, matcher, *target, kLeftBones);
    ASSERT_TRUE(arm);
    CNode& forearm = *FindNode(target.Get(), "LForearm");
    const auto bent = static_cast<size_t>(matcher.IndexOf(&forearm));
    matcher.Bones()[bent].rotation = TurnAbout(kVec3UnitX, 60.0);
    for (size_t bone = 0; bone < matcher.Bones().size(); ++bone)
        matcher.UpdateWorld(bone);
    const Vec3 hand = matcher.Bones()[arm->Hand()].world.Translation();
    const Vec3 elbow = matcher.Bones()[bent].world.Translation();
    std::vector<Ref<CKeyframeControl>> kept;
    std::vector<CKeyframeControl*> tracks;
    for (const CPoseMatcher::Bone& bone : matcher.Bones())
    {
        kept.emplace_back(new CKeyframeControl);
        kept.back()->m_kRotationKeys.assign(1, QuatFromMat3(bone.rotation));
        tracks.push_back(kept.back().Get());
    }
    arm->ReadPose(matcher);
    const Vec3 shoulder = arm->Shoulder(matcher);
    const Vec3 collar = arm->Collar(matcher);
    const ArmTurn turn{{0.05f, -0.1f, 0.15f}, 0.2, -0.1};
    const Vec3 goal = collar + TurnedCollar(shoulder - collar, arm->ChestUp(matcher), turn) +
                      TurnedHand(arm->Lengths(), hand - shoulder, turn);
    arm->Turn(matcher, turn, 0, tracks);
    for (size_t bone = 0; bone < matcher.Bones().size(); ++bone)
    {
        matcher.Bones()[bone].rotation = QuatToMat3(tracks[bone]->m_kRotationKeys[0]);
        matcher.UpdateWorld(bone);
    }
    EXPECT_LT(Vec3Length(matcher.Bones()[arm->Hand()].world.Translation() - goal), 0.01);
    EXPECT_GT(Vec3Length(goal - hand), 50.0);
    EXPECT_LT(Vec3Length(matcher.Bones()[bent].world.Translation() - elbow), 60.0)
        << "not the other way round";
}

} // namespace
} // namespace gw
