#include "CBoneMesh.h"
#include "CFactoryMap.h"
#include "CNode.h"
#include "MeshSamples.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <filesystem>

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

TEST(MeshFile, EveryBlockComesBackAndDamageStaysInside)
{
    COrrinStream stream;
    stream.AddRoot(FullMesh().Get());
    ASSERT_TRUE(SurvivesRewriting(stream));
    uint64_t size = 58 + 14;
    for (const CObject* object : stream.ObjectsInSaveOrder())
        size += object->GetDiskUsed();
    const std::vector<std::byte> whole = SaveBytes(stream);
    EXPECT_EQ(whole.size(), size);
    for (const uint32_t word : {0xffffffffu, 0x15555556u})
    {
        for (size_t at = 0; at + 4 <= whole.size(); ++at)
        {
            std::vector<std::byte> bytes = whole;
            std::memcpy(bytes.data() + at, &word, 4);
            COrrinStream damaged;
            if (!damaged.LoadBuffer(bytes, 0))
                continue;
            ASSERT_TRUE(SurvivesRewriting(damaged)) << word << " at " << at;
            if (CTriMesh* mesh = RecordCast<CTriMesh>(damaged.GetRoot(0)))
            {
                mesh->UpdateScene(0.0f, true);
                mesh->BuildVertexTable();
            }
        }
    }
    for (size_t end = 0; end < whole.size(); ++end)
    {
        COrrinStream cut;
        const bool loaded = LoadBytes(cut, std::span(whole).first(end));
        ASSERT_EQ(loaded, !cut.Record().Failure());
    }
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
    COrrinStream source;
    COrrinStream copied;
    source.AddRoot(root.Get());
    copied.AddRoot(copy.Get());
    EXPECT_EQ(Describe(copied), Describe(source));
    CTriMesh& one = static_cast<CTriMesh&>(*copy->ChildAt(0));
    EXPECT_EQ(one.GetMaterial()->GetRefCount(), 2u);
    EXPECT_NE(one.GetMaterial(), first->GetMaterial());
    EXPECT_EQ(one.m_apkUVWMap[2]->GetRefCount(), 2u);
    const Ref<CTriMesh> bare = static_cast<CTriMesh*>(first->CreateClone());
    EXPECT_EQ(bare->GetMaterial(), nullptr);
}

// Containers from another writer of the format: valid ones keep their graph, all others do no harm.
TEST(ForeignContainers, SurviveLoadingAndSaving)
{
    const std::string folder = SharedDataFolder();
    if (folder.empty())
        GTEST_SKIP() << "no shared data here";
    size_t whole = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder + "containers"))
    {
        if (!entry.is_regular_file() || entry.path().extension() == ".json")
            continue;
        SCOPED_TRACE(entry.path().filename());
        COrrinStream stream;
        const bool loaded = stream.LoadFile(entry.path(), false);
        const bool damaged = static_cast<bool>(stream.Record().Failure());
        EXPECT_TRUE(SurvivesRewriting(stream));
        const std::string kind = entry.path().parent_path().filename();
        EXPECT_FALSE(loaded && kind == "refused");
        for (size_t root = 0; root < stream.GetRootCount(); ++root)
        {
            if (CSpatial* spatial = RecordCast<CSpatial>(stream.GetRoot(root)))
                spatial->UpdateScene(1.5f, true);
        }
        if (damaged || (kind != "good" && kind != "source" && kind != "package"))
            continue;
        EXPECT_EQ(SaveBytes(stream).size() + 21, entry.file_size());
        ++whole;
    }
    EXPECT_GT(whole, 30u);
}

} // namespace gw
