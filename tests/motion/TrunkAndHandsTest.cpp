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

// A body that sits with its thighs along z; its hands are far from everything.
TouchPoints Sitting()
{
    TouchPoints body;
    for (size_t side = 0; side < 2; ++side)
    {
        const float x = side == 0 ? 1.0f : -1.0f;
        body.hips[side] = {95.0f * x, 450.0f, 0.0f};
        body.knees[side] = {95.0f * x, 450.0f, 360.0f};
        body.hands[side] = {400.0f * x, 700.0f, 200.0f};
    }
    body.neck = {0.0f, 1090.0f, 0.0f};
    body.head = {0.0f, 1290.0f, 0.0f};
    return body;
}

TEST(CHandPlan, HandsKeepTheirGapsAndOthersTheirPaths)
{
    const Vec3 free{95.0f, 420.0f, 480.0f}; // past the knee and below it
    // hands of the source; left: the gap of the first one to what it touches
    const std::tuple<const char*, Vec3, Vec3, double> rows[] = {
        {"on a thigh", {95.0f, 510.0f, 250.0f}, {-400.0f, 700.0f, 200.0f}, 60.0},
        {"on the floor", {400.0f, 40.0f, 250.0f}, {-400.0f, 700.0f, 200.0f}, 40.0},
        {"that clap", {30.0f, 900.0f, 400.0f}, {-30.0f, 900.0f, 400.0f}, 60.0},
        {"at the head", {0.0f, 1290.0f, 90.0f}, {-400.0f, 700.0f, 200.0f}, 90.0},
        {"far from it all", {400.0f, 700.0f, 400.0f}, {-400.0f, 700.0f, 200.0f}, -1.0},
    };
    for (size_t touched = 0; const auto& [what, leftHand, rightHand, left] : rows)
    {
        SCOPED_TRACE(what);
        TouchPoints source = Sitting();
        TouchPoints target = source;
        source.hands = {leftHand, rightHand};
        target.hands[0] = free;
        CHandPlan plan(40, 1.0 / 30.0, true);
        for (size_t frame = 0; frame < 40; ++frame)
            plan.Add(frame, source, target);
        plan.Solve();
        EXPECT_EQ(plan.Touches(source), left >= 0.0);
        const Vec3 hand = free + plan.Way(0, 20);
        const Vec3 other = target.hands[1] + plan.Way(1, 20);
        const Vec3 along = hand - Vec3{95.0f, 450.0f, std::min(hand.z, 360.0f)};
        const double gaps[] = {Vec3Length(along), static_cast<double>(hand.y), Vec3Length(hand - other),
                               Vec3Length(hand - target.head)};
        if (left >= 0.0)
            EXPECT_NEAR(gaps[touched++], left, 25.0) << "of 120 and more";
        else
            EXPECT_EQ(Vec3Length(plan.Way(0, 20)), 0.0);
    }
}

// The wanted place is 60 mm above the thigh, 250 mm ahead of the hip, but the arm ends before it.
TEST(CHandPlan, HandOutOfReachGoesToAnotherPlaceOnTheThigh)
{
    TouchPoints source = Sitting();
    source.hands[0] = {95.0f, 510.0f, 250.0f};
    TouchPoints target = source;
    target.hands[0] = {95.0f, 590.0f, 250.0f};
    target.shoulders[0] = {95.0f, 1000.0f, 0.0f};
    target.reach[0] = 510.0;
    CHandPlan plan(40, 1.0 / 30.0, true);
    for (size_t frame = 0; frame < 40; ++frame)
        plan.Add(frame, source, target);
    plan.Solve();
    const Vec3 hand = target.hands[0] + plan.Way(0, 20);
    EXPECT_NEAR(hand.y - 450.0f, 60.0f, 10.0f);
    EXPECT_NEAR(Vec3Length(hand - target.shoulders[0]), 510.0, 5.0);
}

TEST(CFaithfulArm, HandGoesItsWayAndTheElbowStaysOnItsSide)
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
    const Vec3 way{-40.0f, -30.0f, 20.0f};
    arm->MoveHand(matcher, way, 0, tracks);
    for (size_t bone = 0; bone < matcher.Bones().size(); ++bone)
    {
        matcher.Bones()[bone].rotation = QuatToMat3(tracks[bone]->m_kRotationKeys[0]);
        matcher.UpdateWorld(bone);
    }
    EXPECT_LT(Vec3Length(matcher.Bones()[arm->Hand()].world.Translation() - hand - way), 2.0);
    EXPECT_LT(Vec3Length(matcher.Bones()[bent].world.Translation() - elbow), 60.0)
        << "not the other way round";
}

} // namespace
} // namespace gw
