#include "SceneBytes.h"
#include "SceneSamples.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {

TEST(CObject, AnIdIsGivenAgainAtOnceOnlyUnderTheCursor)
{
    Ref<CNode> early = new CNode;
    Ref<CNode> late = new CNode;
    const uint32_t earlyID = early->GetID();
    const uint32_t lateID = late->GetID();
    EXPECT_NE(earlyID, lateID);
    early = nullptr;
    late = nullptr;
    late = new CNode;
    EXPECT_EQ(late->GetID(), lateID);
    early = new CNode;
    EXPECT_NE(early->GetID(), earlyID);
}

TEST(CObject, LivesFromItsFirstReferenceToItsLast)
{
    CNode* raw = new CNode;
    EXPECT_EQ(raw->GetRefCount(), 0u);
    Watch<CNode> watch;
    watch.Set(raw);
    Ref<CNode> held = raw;
    held = raw; // the same object again
    EXPECT_EQ(raw->GetRefCount(), 1u);
    CNode* child = new CNode;
    raw->AttachChild(child);
    held = child; // only held by the reference that is dropped here
    EXPECT_EQ(watch.Get(), nullptr);
    EXPECT_EQ(held->GetRefCount(), 1u);
    EXPECT_EQ(held->GetParent(), nullptr);
}

TEST(CObject, ControlsLiveOnOneObjectOnlyAndKeepTheirOrder)
{
    const Ref<CNode> node = new CNode;
    const Ref<CNode> other = new CNode;
    const Ref<CTestControl> first = new CTestControl;
    const Ref<CTestControl> second = new CTestControl;
    const Ref<CTestControl> third = new CTestControl;
    second->SetNext(third.Get());
    EXPECT_FALSE(node->AttachControl(nullptr));
    EXPECT_TRUE(node->AttachControl(first.Get()));
    EXPECT_TRUE(node->AttachControl(second.Get()));
    EXPECT_FALSE(node->AttachControl(first.Get())) << "attached here already";
    EXPECT_FALSE(other->AttachControl(third.Get())) << "came with the chain";
    EXPECT_EQ(other->GetControl(), nullptr);
    EXPECT_EQ(node->GetControl(), first.Get());
    EXPECT_EQ(first->GetNext(), second.Get());
    EXPECT_EQ(second->GetNext(), third.Get());
    EXPECT_EQ(third->GetNext(), nullptr);
    EXPECT_EQ(third->GetTarget(), node.Get());
}

TEST(CObject, UpdateWalksControlsModifiersAndCustomData)
{
    const Ref<CNode> node = new CNode;
    const Ref<CTestControl> first = new CTestControl(false); // its result does not stop the walk
    const Ref<CTestControl> second = new CTestControl;
    const Ref<CTestControl> onData = new CTestControl;
    const Ref<CTestModifier> modifier = new CTestModifier;
    const Ref<CTestControl> noModifier = new CTestControl;
    const Ref<CTestModifier> behind = new CTestModifier;
    node->AttachControl(first.Get());
    node->AttachControl(second.Get());
    node->AttachModifier(modifier.Get());
    node->AttachModifier(noModifier.Get());
    noModifier->SetNext(behind.Get());
    node->AttachCustomData(new CRawData);
    node->GetCustomData()->AttachControl(onData.Get());
    EXPECT_TRUE(node->Update(2.5f));
    EXPECT_TRUE(node->UpdateRange(9, 4.0f));
    for (const CTestControl* control : {first.Get(), second.Get(), onData.Get()})
        EXPECT_EQ(control->m_kUpdates, (std::vector<float>{2.5f, 4.0f}));
    EXPECT_EQ(modifier->m_iUpdates, 2);
    EXPECT_TRUE(noModifier->m_kUpdates.empty()) << "ends the modifiers";
    EXPECT_EQ(behind->m_iUpdates, 0);
}

TEST(CObject, NothingIsAttachedAfterAHeadThatIsNotAModifier)
{
    const Ref<CNode> node = new CNode;
    const Ref<CTestControl> head = new CTestControl;
    const Ref<CTestModifier> modifier = new CTestModifier;
    EXPECT_TRUE(node->AttachModifier(head.Get()));
    EXPECT_FALSE(node->AttachModifier(modifier.Get()));
    EXPECT_EQ(modifier->GetTarget(), nullptr);
    EXPECT_EQ(modifier->GetRefCount(), 1u);
    EXPECT_TRUE(Ref<CNode>(new CNode)->AttachModifier(modifier.Get())) << "it is free for another object";
}

TEST(CObject, SecondCustomDataIsRefusedWhereTheControlsEndInNone)
{
    const Ref<CNode> node = new CNode;
    const Ref<CRawData> head = new CRawData;
    const Ref<CRawData> more = new CRawData;
    EXPECT_FALSE(node->AttachCustomData(nullptr));
    EXPECT_TRUE(node->AttachCustomData(head.Get()));
    EXPECT_FALSE(node->AttachCustomData(more.Get()));
    node->AttachControl(new CTestControl);
    EXPECT_FALSE(node->AttachCustomData(more.Get()));
    EXPECT_EQ(node->GetCustomData(), head.Get());
    EXPECT_EQ(head->GetNextData(), nullptr);
}

TEST(CObject, SearchGoesThroughAttachmentsBeforeChildrenAndTheFirstHitWins)
{
    const Ref<CNode> root = new CNode;
    root->SetName("hips");
    CNode* left = new CBillboardNode;
    CNode* leg = new CNode;
    CNode* twin = new CNode;
    CKeyframeControl* clips = new CKeyframeClipControl;
    for (CObject* named :
         {static_cast<CObject*>(leg), static_cast<CObject*>(twin), static_cast<CObject*>(clips)})
        named->SetName("leg");
    root->AttachChild(left);
    left->AttachChild(leg);
    root->AttachChild(twin);
    root->AttachControl(new CTestControl);
    root->AttachControl(clips);
    const std::tuple<const char*, const char*, const CRTTI*, bool, CObject*> rows[] = {
        {"everything matches the object itself", nullptr, nullptr, false, root.Get()},
        {"name alone", "leg", nullptr, false, clips},
        {"name and exact class", "leg", &CNode::ms_kRTTI, false, leg},
        {"derived class", nullptr, &CKeyframeControl::ms_kRTTI, true, clips},
        {"exact class passes over derived ones", nullptr, &CKeyframeControl::ms_kRTTI, false, nullptr},
        {"case counts", "Leg", nullptr, false, nullptr},
        {"no name is not an empty name", "", nullptr, false, nullptr},
    };
    for (const auto& [what, name, record, derived, found] : rows)
        EXPECT_EQ(root->FindObject(name, record, derived), found) << what;
    std::vector<CObject*> found;
    root->FindObjects(found, nullptr, &CNode::ms_kRTTI, false);
    EXPECT_EQ(found, (std::vector<CObject*>{root.Get(), leg, twin}));
    left->SetName("");
    EXPECT_EQ(root->FindObject("", nullptr, false), left);
}

TEST(CRTTI, AuthorInfoIsNoCustomDataByItsRecord)
{
    const Ref<CObject> info = new CAuthorInfo;
    const Ref<CObject> raw = new CRawData;
    EXPECT_EQ(DynamicCast(*info, &CCustomData::ms_kRTTI), nullptr);
    EXPECT_EQ(DynamicCast(*raw, &CCustomData::ms_kRTTI), raw.Get());
    EXPECT_EQ(DynamicCast(*raw, nullptr), nullptr);
}

TEST(Clone, IsTheSameGraphWithIdsOfItsOwn)
{
    Ref<CNode> root = SampleGraph();
    root->AttachChild(new CNode); // into the empty slot, because a clone's children are packed
    CObject* billboard = root->FindObject(nullptr, &CBillboardNode::ms_kRTTI, false);
    billboard->GetControl()->SetTarget(billboard);
    std::vector<CObject*> clips;
    root->FindObjects(clips, nullptr, &CKeyframeClipControl::ms_kRTTI, false);
    for (CObject* control : clips)
        static_cast<CControl*>(control)->m_iCycleType = 0; // as in a copy
    ++root->m_uiChangeStamp;

    CCloneMap map;
    const Ref<CNode> copy = static_cast<CNode*>(root->Clone(map));
    EXPECT_EQ(DescribeRoot(copy.Get()), DescribeRoot(root.Get()));
    EXPECT_NE(copy->GetID(), root->GetID());
    EXPECT_NE(copy->GetControl(), root->GetControl());
    EXPECT_EQ(copy->m_uiChangeStamp, 0u);
    EXPECT_EQ(root->Clone(map), copy.Get()) << "the map knows it";
}

TEST(Clone, ModifiersAndRenderStatesComeAlongABareCopyHasNothing)
{
    const Ref<CNode> node = new CNode;
    node->SetName("n");
    node->AttachModifier(new CTestModifier);
    for (const size_t type : {2, 5, 1})
        node->AttachRenderState(*new CTestState(type));
    CCloneMap map;
    const Ref<CNode> copy = static_cast<CNode*>(node->Clone(map));
    ASSERT_NE(copy->GetModifier(), nullptr);
    EXPECT_EQ(static_cast<CModifier*>(copy->GetModifier())->GetTarget(), copy.Get());
    std::vector<size_t> types;
    for (CObject* held : copy->HeldObjects())
    {
        if (const auto* state = RecordCast<CRenderState>(held))
            types.push_back(state->GetType());
    }
    EXPECT_EQ(types, (std::vector<size_t>{2, 5, 1})) << "attached one by one, each at the front";
    const Ref<CNode> bare = static_cast<CNode*>(node->CreateClone());
    EXPECT_EQ(bare->NameView(), "n");
    EXPECT_TRUE(bare->HeldObjects().empty());
}

} // namespace gw
