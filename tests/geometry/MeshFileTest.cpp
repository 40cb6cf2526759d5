#include "CBoneMesh.h"
#include "CNode.h"
#include "MeshSamples.h"
#include "SceneBytes.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

// Returns a mesh of one triangle with inconsistent counts: no normals although there are 5, no colors
// although there are -6, and 7 render vertices of which only the normals have a list.
CSceneBytes OddMesh(uint32_t presence)
{
    CSceneBytes bytes;
    bytes.EmptyThumbnail().Root().Object("CTriMesh", 1, "odd").Spatial();
    bytes.Word(3).Add(kVec3Zero).Add(kVec3UnitX).Add(kVec3UnitY).Word(0);
    bytes.Words({5, 0, uint32_t(-6), 0, 7, 0, presence, 1, 2, 3, 4, 5, 6, 7, 0}).Word(0).Byte(0);
    bytes.Words({1, presence, 0, 1, 2, 0, 0, 0, 0, 0});
    bytes.Words({2, 2, 0, 1, 9, uint32_t(-1), 3}); // maps, ranges
    bytes.Object("CTriMeshUVWMap", 2).Words({4, 0, 1, presence, 8, 8, 8, 0, 0});
    return bytes;
}

// Adds the part that is common to all controls, without a target.
CSceneBytes& Control(CSceneBytes& bytes, std::string_view className)
{
    bytes.Root().Object(className, 1).Word(1).Float(2).Float(3).Float(4).Float(5).Byte(1).Words({0, 0});
    return bytes;
}

} // namespace

TEST(MeshFile, CountsWithoutBlocksAreKeptAndAnyWordMeansPresent)
{
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, OddMesh(0xdeadbeef).Bytes()));
    EXPECT_EQ(SaveBytes(stream), OddMesh(1).Bytes());
    CTriMesh& mesh = static_cast<CTriMesh&>(*stream.GetRoot(0));
    EXPECT_EQ(mesh.GetVertexQuantity(), 7);
    EXPECT_TRUE(mesh.VertexXYZIndex().empty());
    EXPECT_EQ(mesh.WorldXYZBuffer().size(), 3u);
    EXPECT_EQ(mesh.m_apkUVWMap[1].Get(), nullptr);
    EXPECT_TRUE(mesh.m_bAutoNormals);
    mesh.UpdateScene(0.0f, true);
    mesh.BuildVertexTable();
    EXPECT_EQ(mesh.GetVertexQuantity(), 3);
}

TEST(MeshFile, PointsBelowNoneAreNoneAndOtherBlocksBelowNoneAreDamage)
{
    CSceneBytes none;
    none.EmptyThumbnail().Root().Object("CTriMesh", 1).Spatial().Word(uint32_t(-3));
    none.Words({0, 0, 0, 0, 0, 0, 0, 0, 0, 0}).Byte(0).Words({0x7fffffff, 0, 0, 0, 0, 0, 0, 0, 0});
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, none.Bytes()));
    CTriMesh& mesh = static_cast<CTriMesh&>(*stream.GetRoot(0));
    mesh.UpdateScene(0.0f, true);
    mesh.BuildVertexTable(); // triangles without lists take no memory
    EXPECT_TRUE(mesh.VertexTriIndexBuffer().empty());
    EXPECT_EQ(mesh.GetTriangleQuantity(), 0x7fffffff);

    CSceneBytes damaged;
    damaged.EmptyThumbnail().Root().Object("CTriMesh", 1).Spatial().Words({0, 0, uint32_t(-1), 1});
    damaged.Words({0, 0, 0, 0, 0, 0, 0}).Byte(0).Words({0, 0, 0, 0, 0, 0, 0, 0, 0});
    EXPECT_FALSE(LoadBytes(stream, damaged.Bytes()));
    EXPECT_EQ(stream.Record().Failure().reason, EFailure::BadCount);
}

TEST(MeshFile, ABoneMeshIsWrittenAndNotReadBack)
{
    const Ref<CBoneShapeMesh> mesh = new CBoneShapeMesh;
    mesh->Build(2.0f);
    COrrinStream stream;
    stream.AddRoot(mesh.Get());
    const std::vector<std::byte> bytes = SaveBytes(stream);
    EXPECT_EQ(bytes.size(), 58 + 14 + mesh->GetDiskUsed());
    COrrinStream again;
    EXPECT_FALSE(LoadBytes(again, bytes));
    EXPECT_EQ(again.Record().Failure().name, "CBoneShapeMesh");

    CCloneMap map;
    const Ref<CTriMesh> clone = static_cast<CTriMesh*>(mesh->Clone(map));
    EXPECT_EQ(clone->GetRTTI(), &CTriMesh::ms_kRTTI);
    EXPECT_TRUE(clone->m_bBoneMesh);
    EXPECT_TRUE(std::ranges::equal(clone->XYZBuffer(), mesh->XYZBuffer()));
}

TEST(Clone, MeshesShareTheCopyOfWhatTheyShare)
{
    const Ref<CNode> root = new CNode;
    const Ref<CTriMesh> first = FullMesh();
    const Ref<CTriMesh> second = Cube();
    first->SetMaterial(new CTestMaterial);
    second->SetMaterial(first->GetMaterial());
    second->m_apkUVWMap.emplace_back(first->m_apkUVWMap[2].Get());
    root->AttachChild(first.Get());
    root->AttachChild(second.Get());
    CCloneMap map;
    const Ref<CNode> copy = static_cast<CNode*>(root->Clone(map));
    EXPECT_EQ(DescribeRoot(copy.Get()), DescribeRoot(root.Get()));
    EXPECT_NE(static_cast<CTriMesh&>(*copy->ChildAt(0)).GetMaterial(), first->GetMaterial());
    const Ref<CTriMesh> bare = static_cast<CTriMesh*>(first->CreateClone());
    EXPECT_EQ(bare->GetMaterial(), nullptr);
}

TEST(ControlFile, PointsOfASkinAreSortedAndOneRecordEach)
{
    CSceneBytes mixed = Scene();
    const auto point = [&](uint32_t index, float weight) {
        mixed.Words({index, 1, 0}).Float(weight).Add(kMat4Identity);
    };
    Control(mixed, "CSkinBoneControl").Word(3);
    point(8, 1);
    point(2, 2);
    point(8, 3);
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, mixed.Bytes()));
    const auto& sorted = static_cast<const CSkinBoneControl&>(*stream.GetRoot(0)).Points();
    ASSERT_EQ(sorted.size(), 2u) << "one record per point";
    EXPECT_EQ(sorted[0].m_uiIndex, 2u);
    EXPECT_EQ(sorted[1].m_kEntries[1].m_fWeight, 3.0f);
}

TEST(ControlFile, ASceneOfAllClassesComesBackByCloneAndByFile)
{
    const Ref<CNode> scene = ControlledScene();
    ExpectComesBack(scene.Get());
    CCloneMap map;
    const Ref<CObject> copy = scene->Clone(map);
    EXPECT_EQ(DescribeRoot(copy.Get()), DescribeRoot(scene.Get())) << "bones and meshes are copies, too";
    const CObject* mesh = copy->FindObject(nullptr, &CTriMesh::ms_kRTTI, false);
    CConnectControl* seam =
        static_cast<CConnectControl*>(copy->FindObject(nullptr, &CConnectControl::ms_kRTTI, false));
    EXPECT_EQ(seam->m_spkConnectData->m_kFirst.m_pkMesh.Get(), mesh);
}

TEST(ControlFile, NoDamageReachesOutsideOrStaysInAnUpdate)
{
    const auto use = [](CObject& root) {
        std::vector<CObject*> meshes;
        root.FindObjects(meshes, nullptr, &CTriMesh::ms_kRTTI, false);
        if (CSpatial* spatial = RecordCast<CSpatial>(&root))
            spatial->UpdateScene(1.5f, true);
        for (CObject* mesh : meshes)
            static_cast<CTriMesh*>(mesh)->BuildVertexTable();
        if (CSpatial* spatial = RecordCast<CSpatial>(&root))
            spatial->UpdateScene(2.5f, true);
    };
    ExpectDamageStaysInside(ControlledScene().Get(), {0xffffffffu, 0x7f800000u, 0u}, use);
}

TEST(ControlFile, MeshesAndBonesThatDieLeaveNothingBehind)
{
    Ref<CNode> scene = ControlledScene();
    const Ref<CTriMesh> mesh = static_cast<CTriMesh*>(scene->ChildAt(0));
    scene = nullptr; // deletes the bone and the other mesh too
    mesh->UpdateScene(1.5f, true);
    mesh->UpdateScene(2.5f, true);
    const auto& skin = static_cast<const CBoneSkinControl&>(*mesh->GetControl());
    EXPECT_FALSE(skin.Bones()[0].m_pkBone);
}

} // namespace gw
