// The wheel, a followed figure, and the bone under the mouse.

#include "FindHip.h"
#include "PreviewScene.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

CNode& Attach(CNode& parent, const char* name, const Vec3& place = kVec3Zero)
{
    Ref<CNode> node = new CNode;
    node->SetName(name);
    node->m_kMatrix.SetTranslation(place);
    parent.AttachChild(node.Get());
    return *node;
}

void AttachLeg(CNode& hip, const char* name)
{
    Attach(Attach(Attach(hip, name), "shin"), "foot");
}

TEST(Hip, IsWhereLegsAndTrunkPart)
{
    const Ref<CNode> scene = MakeScene({});
    Attach(*scene, "prop");
    CNode& hip = Attach(Attach(*scene, "armature"), "hip");
    AttachLeg(hip, "left");
    AttachLeg(hip, "right");
    CNode& chest = Attach(Attach(hip, "spine"), "chest");
    EXPECT_EQ(FindHip(*scene), &hip);
    AttachLeg(chest, "arm");
    AttachLeg(chest, "other arm");
    EXPECT_EQ(FindHip(*scene), &hip);
    CNode& alone = Attach(*scene, "alone");
    EXPECT_EQ(FindHip(alone), &alone);
}

TEST(Wheel, MovesTheEyeTowardWhatItLooksAtButNotPastIt)
{
    const std::tuple<double, float> rows[] = {{1, 110}, {-1, 131.111f}, {1000, 20}, {-1000, 2020}};
    for (const auto& [notches, eyeZ] : rows)
    {
        CCountedView view;
        view.Dolly(notches);
        view.SetScene(MakeScene({{0, 0, 20}, 40}).Get(), 1.0f, 1.0f);
        view.Dolly(notches);
        EXPECT_NEAR(view.m_kCamera.m_kEye.z, eyeZ, 1e-3) << notches;
        EXPECT_EQ(view.m_iRepaints, 2);
    }
}

TEST(Follow, KeepsTheHipInTheMiddleAndLeavesItThere)
{
    const Ref<CNode> scene = MakeScene({});
    CNode& hip = Attach(*scene, "hip", {1, 2, 3});
    AttachLeg(hip, "left");
    AttachLeg(hip, "right");
    scene->UpdateScene(0.0f, true);
    scene->m_kBound = {kVec3Zero, 200};
    CGLView view;
    view.SetScene(scene.Get(), 1.0f, 1.0f);
    view.m_kPan = {7, 7, 0};
    const auto middle = [&] { return view.BoneAt({50, 50, 100, 100}); };
    AttachBone(hip, "mesh", 1);
    view.SetFollow(true);
    EXPECT_EQ(view.ShownPan(), (Vec3{-1, -2, -3}));
    hip.m_kMatrix.SetTranslation({100, 0, 0});
    scene->UpdateScene(0.0f, true);
    EXPECT_EQ(view.ShownPan(), (Vec3{-100, 0, 0}));
    EXPECT_EQ(middle(), "mesh");
    view.SetFollow(false);
    EXPECT_EQ(view.ShownPan(), (Vec3{-100, 0, 0})) << "nothing jumps";
    hip.m_kMatrix.SetTranslation({200, 0, 0});
    scene->UpdateScene(0.0f, true);
    EXPECT_EQ(middle(), "");
    EXPECT_EQ(view.BoneAt({74, 50, 100, 100}), "mesh");
}

} // namespace
} // namespace gw
