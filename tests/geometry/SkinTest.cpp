#include "MeshSamples.h"
#include "Rotations.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

struct Influence
{
    CNode* bone;
    float weight;
};

// A mesh of two points, (1, 0, 0) and (0, 0, 1), moved up by 10, and two bones at other places.
class Skin : public testing::Test
{
protected:
    void SetUp() override
    {
        m_kMesh->m_kMatrix = Moved(0, 10, 0);
        m_kA->SetName("left");
        m_kB->SetName("right");
        m_kRoot->AttachChild(m_kA.Get());
        m_kRoot->AttachChild(m_kB.Get());
        m_kRoot->AttachChild(m_kMesh.Get());
        m_kA->m_kMatrix = Moved(100, 0, 0);
        m_kB->m_kMatrix = Moved(0, 0, 100);
    }
    template <class T>
    T& Attach(const std::vector<Influence>& influences, const Mat4& offset = kMat4Identity)
    {
        T* skin = new T;
        m_kMesh->AttachControl(skin);
        for (const Influence& influence : influences)
            skin->AddInfluence(*influence.bone, 0, influence.weight, offset);
        if constexpr (requires { skin->RebuildSkinTables(); })
            skin->RebuildSkinTables();
        return *skin;
    }
    void Update() { m_kRoot->UpdateScene(0.0f, false); }
    const Vec3& Point(size_t index) { return m_kMesh->WorldXYZBuffer()[index]; }

    Ref<CNode> m_kRoot = new CNode;
    Ref<CNode> m_kA = new CNode;
    Ref<CNode> m_kB = new CNode;
    Ref<CTriMesh> m_kMesh = PointMesh({kVec3UnitX, kVec3UnitZ});
};

} // namespace

TEST_F(Skin, WhatWeightsLackGoesToTheMeshAndTooMuchDividesThePoint)
{
    const std::tuple<const char*, std::vector<Influence>, Vec3> rows[] = {
        {"no bone", {}, {1, 10, 0}},
        {"weight 0", {{m_kA.Get(), 0}}, {1, 10, 0}},
        {"one bone", {{m_kA.Get(), 1}}, {101, 0, 0}},
        {"half of the rest", {{m_kA.Get(), 0.25f}, {m_kB.Get(), 0.25f}}, {26, 5, 25}},
        {"too much", {{m_kA.Get(), 1}, {m_kB.Get(), 1}}, {51, 0, 50}},
        {"below nothing", {{m_kA.Get(), -1}}, {-99, 20, 0}},
    };
    for (const auto& [what, weights, expected] : rows)
    {
        SCOPED_TRACE(what);
        m_kMesh->DetachControls();
        Attach<CBoneSkinControl>(weights);
        const uint32_t stamp = m_kMesh->m_uiChangeStamp;
        Update();
        ExpectNear(Point(0), expected, 1e-4);
        ExpectNear(Point(1), {0, 10, 1}, 1e-4);
        EXPECT_EQ(m_kMesh->m_uiChangeStamp, stamp + 1);
    }
}

TEST_F(Skin, OffsetsTakeTheModelToTheBoneAndTheFirstOneStays)
{
    CBoneSkinControl& skin = Attach<CBoneSkinControl>({{m_kA.Get(), 0.5f}}, Moved(0, 0, 7));
    skin.AddInfluence(*m_kA, 0, 0.5f, Moved(0, 0, 99));
    skin.AddInfluence(*m_kA, 5, 1.0f, kMat4Identity); // no such point
    skin.RebuildSkinTables();
    Update();
    ExpectNear(Point(0), {101, 0, 7}, 1e-4);
    EXPECT_EQ(skin.Bones()[0].m_kInfluences[0].SkinID, 5u) << "new ones come first";
    skin.m_bActive = false;
    EXPECT_FALSE(skin.Update(0.0f));
    Update();
    ExpectNear(Point(0), {1, 10, 0}, 1e-4);
}

TEST_F(Skin, TablesListPointsInOrderAndGroupThemByTheirInfluences)
{
    m_kMesh->SetPointCount(8);
    m_kMesh->UpdateScene(0.0f, false);
    CBoneSkinControl& skin = Attach<CBoneSkinControl>({});
    const std::tuple<CNode*, uint32_t, float> influences[] = {
        {m_kA.Get(), 6, 0.5f}, {m_kA.Get(), 2, 0.25f},
        {m_kA.Get(), 3, 1.0f}, {m_kA.Get(), 9, 1.0f}, // no such point
        {m_kB.Get(), 6, 2.0f}, {m_kB.Get(), 4, 0.0f}, // acts on nothing
        {m_kB.Get(), 6, 3.0f},
    };
    for (const auto& [bone, point, weight] : influences)
        skin.AddInfluence(*bone, point, weight, kMat4Identity);
    skin.RebuildSkinTables();
    std::vector<uint32_t> points;
    for (const CSkinPointRecord& record : skin.Points())
        points.push_back(record.point);
    EXPECT_EQ(points, (std::vector<uint32_t>{2, 3, 6}));
    EXPECT_TRUE(std::ranges::equal(skin.Points()[2].bones,
                                   std::vector<CSpatial*>{m_kA.Get(), m_kB.Get(), m_kB.Get()}));
    EXPECT_TRUE(std::ranges::equal(skin.Points()[2].weights, std::vector{0.5f, 3.0f, 2.0f}));
    std::string groups;
    for (const auto& row : skin.Groups())
    {
        for (const SkinPointRun& run : row)
        {
            for (uint32_t point = run.begin; point < run.end; ++point)
                groups += std::to_string(point);
        }
        groups += ' ';
    }
    EXPECT_EQ(groups, "01457 23  6 ");
    m_kMesh->SetPointCount(3);
    Update();
    EXPECT_EQ(skin.Points().size(), 1u) << "made again for another number of points";
}

TEST_F(Skin, ASecondSkinStartsFromTheWorld)
{
    Attach<CBoneSkinControl>({{m_kA.Get(), 1}});
    CBoneSkinControl& second = Attach<CBoneSkinControl>({{m_kB.Get(), 1}});
    Update();
    ExpectNear(Point(0), {101, -10, 100}, 1e-4); // back to model space, then moved by the second bone
    ExpectNear(Point(1), {0, 20, 1}, 1e-4);      // moved by the mesh twice
    second.m_bActive = false;
    Attach<CSkinBoneControl>({{m_kB.Get(), 2}});
    Update();
    ExpectNear(Point(0), {202, -20, 200}, 1e-4);
}

TEST_F(Skin, ByPointAPlaceIsTheSumOfItsBonesAndOthersCollapse)
{
    CSkinBoneControl& skin =
        Attach<CSkinBoneControl>({{m_kA.Get(), 0.5f}, {m_kB.Get(), 0.5f}}, Moved(0, 0, 8));
    for (const uint32_t point : {9u, 4u}) // no such points
        skin.AddInfluence(*m_kA, point, 1.0f, kMat4Identity);
    EXPECT_EQ(skin.Points()[1].m_uiIndex, 4u) << "in ascending order";
    const uint32_t stamp = m_kMesh->m_uiChangeStamp;
    Update();
    ExpectNear(Point(0), {51, 0, 58}, 1e-4);
    EXPECT_EQ(Point(1), kVec3Zero);
    EXPECT_EQ(m_kMesh->m_uiChangeStamp, stamp + 1);
    skin.m_bActive = false;
    Update();
    ExpectNear(Point(1), {0, 10, 1}, 1e-4);
}

TEST_F(Skin, BonesThatDieGiveTheirShareToTheMesh)
{
    const Ref<CNode> lost = new CNode;
    Attach<CBoneSkinControl>({{m_kA.Get(), 0.5f}, {lost.Get(), 0.5f}});
    const_cast<Ref<CNode>&>(lost) = nullptr;
    Update();
    ExpectNear(Point(0), {51, 5, 0}, 1e-4);
}

TEST_F(Skin, BindGoesOverToTheBonesOfTheSameNames)
{
    const Ref<CNode> unnamed = new CNode;
    const std::vector<Influence> influences = {
        {m_kA.Get(), 0.5f}, {m_kB.Get(), 0.25f}, {unnamed.Get(), 0.25f}};
    CBoneSkinControl& byBone = Attach<CBoneSkinControl>(influences);
    CSkinBoneControl& byPoint = Attach<CSkinBoneControl>(influences);
    const Ref<CNode> other = new CNode; // has no "right"
    CNode* a = new CBillboardNode;
    a->SetName("left");
    other->AttachChild(new CNode);
    other->AttachChild(a);
    m_kMesh->Bind(*other);
    ASSERT_EQ(byBone.Bones().size(), 1u);
    EXPECT_EQ(byBone.Bones()[0].m_pkBone.Get(), a);
    ASSERT_EQ(byPoint.Points()[0].m_kEntries.size(), 1u);
    EXPECT_EQ(byPoint.Points()[0].m_kEntries[0].m_pkBone.Get(), a);
    byPoint.m_bActive = false;
    a->m_kWorldMatrix = Moved(0, 500, 0);
    Update();
    ExpectNear(Point(0), {1, 255, 0}, 1e-4);
}

TEST_F(Skin, CopiesFollowCopiedBonesAndRebindDropsTheOthers)
{
    const Ref<CNode> outside = new CNode;
    CBoneSkinControl& byBone = Attach<CBoneSkinControl>({{m_kB.Get(), 0.5f}, {outside.Get(), 0.5f}});
    CSkinBoneControl& byPoint = Attach<CSkinBoneControl>({{m_kB.Get(), 0.5f}, {outside.Get(), 0.5f}});
    m_kRoot->DetachChild(m_kB.Get());
    m_kRoot->AttachChild(new CNode);
    m_kRoot->AttachChild(m_kB.Get()); // after the mesh
    CCloneMap map;
    const Ref<CNode> root = static_cast<CNode*>(m_kRoot->Clone(map));
    CSpatial* const copied = static_cast<CNode*>(root->FindObject("right", nullptr, false));
    ASSERT_NE(copied, m_kB.Get());
    auto& mesh = static_cast<CTriMesh&>(*root->FindObject(nullptr, &CTriMesh::ms_kRTTI, false));
    auto& boneCopy = static_cast<CBoneSkinControl&>(*mesh.GetControl());
    auto& pointCopy = static_cast<CSkinBoneControl&>(*mesh.GetControl()->GetNext());
    EXPECT_EQ(boneCopy.Bones()[0].m_pkBone.Get(), copied);
    EXPECT_EQ(boneCopy.Bones()[1].m_pkBone.Get(), outside.Get()) << "what was not cloned stays";
    for (int time = 0; time < 2; ++time) // the second update must change nothing
    {
        root->Rebind(map);
        ASSERT_EQ(boneCopy.Bones().size(), 1u);
        EXPECT_EQ(boneCopy.Bones()[0].m_pkBone.Get(), copied);
        ASSERT_EQ(pointCopy.Points()[0].m_kEntries.size(), 1u);
        EXPECT_EQ(pointCopy.Points()[0].m_kEntries[0].m_pkBone.Get(), copied);
    }
    EXPECT_EQ(byBone.Bones()[0].m_pkBone.Get(), m_kB.Get()) << "the source keeps its own";
    EXPECT_EQ(byPoint.Points()[0].m_kEntries.size(), 2u);
}

} // namespace gw
