#include "SceneSamples.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <tuple>

namespace gw {
namespace {

Mat4 At(float x, float y, float z)
{
    return Mat4Compose(kMat3Identity, {x, y, z});
}

std::vector<CObject*> Slots(const CNode& node)
{
    std::vector<CObject*> slots;
    for (size_t slot = 0; slot < node.GetChildCount(); ++slot)
        slots.push_back(node.ChildAt(slot));
    return slots;
}

TEST(CNode, ChildrenFillTheFirstEmptySlotAndGrowByTwo)
{
    const Ref<CNode> node = new CNode;
    CNode* a = new CNode;
    CNode* c = new CNode;
    CNode* d = new CNode;
    const Ref<CNode> b = new CNode;
    EXPECT_FALSE(node->AttachChild(nullptr));
    node->AttachChild(a);
    EXPECT_EQ(Slots(*node), (std::vector<CObject*>{a, nullptr}));
    node->AttachChild(b.Get());
    node->AttachChild(c);
    EXPECT_EQ(Slots(*node), (std::vector<CObject*>{a, b.Get(), c, nullptr}));
    EXPECT_TRUE(node->DetachChild(b.Get()));
    EXPECT_TRUE(node->DetachChild(b.Get())) << "not there any more";
    EXPECT_FALSE(node->DetachChild(nullptr));
    EXPECT_EQ(b->GetParent(), nullptr);
    node->AttachChild(d);
    EXPECT_EQ(Slots(*node), (std::vector<CObject*>{a, d, c, nullptr}));
    EXPECT_EQ(node->GetChild(99).Get(), nullptr);
}

TEST(CNode, SetChildAtAnswersThePreviousAndGrowsByItsOwnMeasure)
{
    const Ref<CNode> node = new CNode(3);
    CNode* first = new CNode;
    CNode* second = new CNode;
    EXPECT_EQ(node->SetChildAt(1, first).Get(), nullptr);
    EXPECT_EQ(Slots(*node), (std::vector<CObject*>{nullptr, first, nullptr, nullptr}));
    const Ref<CSpatial> previous = node->SetChildAt(1, second);
    EXPECT_EQ(previous.Get(), first);
    EXPECT_EQ(first->GetParent(), nullptr);
    EXPECT_EQ(second->GetParent(), node.Get());
    for (const uint32_t growBy : {0u, 0xffffffffu}) // as a file may contain it
    {
        const Ref<CNode> odd = new CNode(growBy);
        odd->SetChildAt(0, new CNode);
        EXPECT_NE(odd->ChildAt(0), nullptr);
    }
}

TEST(CNode, AChildMovesByAttachingAndSurvivesItsParents)
{
    Ref<CNode> first = new CNode;
    Ref<CNode> second = new CNode;
    const Ref<CNode> child = new CNode;
    first->AttachChild(child.Get());
    second->AttachChild(child.Get());
    EXPECT_EQ(child->GetParentNode(), second.Get());
    EXPECT_EQ(first->ChildAt(0), child.Get()) << "attaching does not take it from where it was";
    first = nullptr;
    second = nullptr;
    EXPECT_EQ(child->GetParent(), nullptr);
}

TEST(CNode, CopySkeletonLeavesAllButNodesBehind)
{
    const Ref<CNode> root = SampleGraph();
    CCloneMap map;
    const Ref<CNode> copy = root->CopySkeleton(map);
    EXPECT_EQ(root->CopySkeleton(map), copy.Get());
    EXPECT_EQ(copy->NameView(), "root");
    EXPECT_EQ(copy->GetControl(), nullptr);
    ASSERT_EQ(copy->GetChildCount(), 2u) << "packed";
    EXPECT_EQ(copy->ChildAt(0)->GetRTTI(), &CBillboardNode::ms_kRTTI);
    EXPECT_FALSE(copy->HasNoNodeChild());
    EXPECT_TRUE(static_cast<CNode*>(copy->ChildAt(0))->HasNoNodeChild());
}

TEST(CSpatial, TwoAnswersOfTransformControlsKeepTheOldWorldMatrix)
{
    const std::tuple<const char*, std::vector<bool>, bool> rows[] = {
        {"no control", {}, true},
        {"one that rewrote", {true}, true},
        {"none that rewrote", {false, false, false}, true},
        {"one of two", {false, true}, true},
        {"two", {true, true}, false},
        {"two of three", {true, false, true}, false},
    };
    for (const auto& [what, answers, fresh] : rows)
    {
        SCOPED_TRACE(what);
        const Ref<CNode> node = new CNode;
        for (const bool answer : answers)
            node->AttachControl(new CTestControl(answer));
        node->m_kMatrix = At(1, 2, 3);
        node->UpdateTransform(0.0f);
        EXPECT_EQ(node->m_kWorldMatrix == At(1, 2, 3), fresh);
        for (CControl* control = node->GetControl(); control; control = control->GetNext())
            EXPECT_EQ(static_cast<CTestControl*>(control)->m_iTransforms, 1);
    }
}

TEST(BoundSphere, MergeGrowsJustAsFarAsItMust)
{
    const BoundSphere unit{kVec3Zero, 1.0f};
    const std::tuple<const char*, BoundSphere, BoundSphere, BoundSphere> rows[] = {
        {"side by side", unit, {{4, 0, 0}, 1}, {{2, 0, 0}, 3}},
        {"unequal", unit, {{5, 0, 0}, 2}, {{3, 0, 0}, 4}},
        {"around", {{0, 1, 0}, 5}, unit, {{0, 1, 0}, 5}},
        {"inside", unit, {{0, 1, 0}, 5}, {{0, 1, 0}, 5}},
        {"equal", unit, unit, unit},
        {"a point at the origin counts", {{0, 0, 6}, 1}, {kVec3Zero, 0}, {{0, 0, 3.5f}, 3.5f}},
    };
    for (const auto& [what, a, b, merged] : rows)
    {
        SCOPED_TRACE(what);
        BoundSphere sphere = a;
        sphere.Merge(b);
        EXPECT_EQ(sphere.m_kCentre, merged.m_kCentre);
        EXPECT_FLOAT_EQ(sphere.m_fRadius, merged.m_fRadius);
    }
    const Vec3 points[] = {{-1, 0, 0}, {3, 0, 0}, {1, 1, 0}};
    EXPECT_EQ(BoundOfPoints(points).m_kCentre, (Vec3{1, 0.5f, 0}));
    EXPECT_FLOAT_EQ(BoundOfPoints(points).m_fRadius, std::sqrt(4.25f));
    EXPECT_EQ(BoundOfPoints({}).m_fRadius, 0.0f);
}

class CProbe : public CNode
{
public:
    void UpdateBound() override { m_kBound = {{4, 0, 0}, 1}; }
    void ApplyRenderStates(RenderStateStack& stack) override
    {
        for (size_t type = 0; type < kRenderStateTypes; ++type)
            m_apkTop[type] = stack.Top(type);
    }
    CRenderState* m_apkTop[kRenderStateTypes] = {};
};

TEST(CSpatial, UpdateOfALeafRefreshesTheBoundsAboveIt)
{
    const Ref<CNode> root = new CNode;
    CNode* middle = new CNode;
    CNode* leaf = new CProbe;
    root->AttachChild(middle);
    middle->AttachChild(leaf);
    leaf->UpdateScene(0.0f, false);
    EXPECT_EQ(root->m_kBound.m_fRadius, 0.0f);
    leaf->UpdateScene(0.0f, true);
    EXPECT_EQ(root->m_kBound.m_kCentre, (Vec3{4, 0, 0}));
    middle->DetachChild(leaf);
    middle->UpdateScene(0.0f, true);
    EXPECT_EQ(root->m_kBound.m_fRadius, 1.0f) << "a node without children keeps the bound it has";
}

TEST(RenderStates, TheNearestOfEachTypeIsInForce)
{
    const Ref<CNode> root = new CNode;
    CNode* middle = new CNode;
    CProbe* leaf = new CProbe;
    root->AttachChild(middle);
    middle->AttachChild(leaf);
    const Ref<CTestState> far = new CTestState(0);
    const Ref<CTestState> near = new CTestState(0);
    const Ref<CTestState> other = new CTestState(3);
    root->AttachRenderState(*far);
    root->AttachRenderState(*other);
    middle->AttachRenderState(*new CTestState(0));
    EXPECT_NE(middle->AttachRenderState(*near).Get(), nullptr) << "one of each type";
    for (CSpatial* start : {static_cast<CSpatial*>(root.Get()), static_cast<CSpatial*>(leaf)})
    {
        std::ranges::fill(leaf->m_apkTop, nullptr);
        start->PushAndApply(nullptr);
        EXPECT_EQ(leaf->m_apkTop[0], near.Get());
        EXPECT_EQ(leaf->m_apkTop[3], other.Get());
        EXPECT_EQ(leaf->m_apkTop[6], nullptr);
    }
}

TEST(RenderStates, AFullStackDropsThePushAndAnEmptyOneThePop)
{
    const Ref<CTestState> first = new CTestState(1);
    const Ref<CTestState> last = new CTestState(1);
    RenderStateStack stack;
    stack.Pop(*first);
    for (int i = 0; i < 127; ++i)
        stack.Push(*first);
    stack.Push(*last);
    EXPECT_EQ(stack.Top(1), first.Get());
    for (int i = 0; i < 127; ++i)
        stack.Pop(*first);
    EXPECT_EQ(stack.Top(1), nullptr);
}

} // namespace
} // namespace gw
