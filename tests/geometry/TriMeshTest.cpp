#include "CNode.h"
#include "FailingAllocations.h"
#include "MeshSamples.h"
#include "Rotations.h"
#include "SceneBytes.h"
#include "SceneSamples.h"

#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <random>

namespace gw {

// Implements the rule literally: an ordered set of keys, and the rank of each corner's key in it.
TEST(VertexTable, VerticesAreNumberedByTheOrderOfTheirSignedKeys)
{
    const Ref<CTriMesh> mesh = FullMesh();
    std::mt19937 random(7);
    CTriMeshUVWMap& first = *mesh->m_apkUVWMap[0];
    CTriMeshUVWMap& second = *mesh->m_apkUVWMap[2];
    const std::span<uint32_t> lists[] = {mesh->XYZTriIndexBuffer(), mesh->NormalTriIndexBuffer(),
                                         mesh->ColorTriIndexBuffer(), first.UVWTriIndexBuffer(),
                                         second.UVWTriIndexBuffer()};
    std::map<std::vector<int32_t>, uint32_t> rank;
    std::vector<std::vector<int32_t>> keys(36);
    for (size_t corner = 0; corner < 36; ++corner)
    {
        for (const auto& list : lists)
        {
            list[corner] = static_cast<uint32_t>(random() % 5) - 2; // some are below 0 as signed numbers
            keys[corner].push_back(static_cast<int32_t>(list[corner]));
        }
        rank[keys[corner]] = 0;
    }
    for (uint32_t number = 0; auto& [indices, own] : rank)
        own = number++;

    mesh->BuildVertexTable();
    ASSERT_EQ(mesh->GetVertexQuantity(), static_cast<int32_t>(rank.size()));
    for (size_t corner = 0; corner < 36; ++corner)
    {
        const uint32_t vertex = mesh->VertexTriIndexBuffer()[corner];
        ASSERT_EQ(vertex, rank[keys[corner]]);
        EXPECT_EQ(mesh->VertexXYZIndex()[vertex], lists[0][corner]);
        EXPECT_EQ(mesh->VertexNormalIndex()[vertex], lists[1][corner]);
        EXPECT_EQ(mesh->VertexColorIndex()[vertex], lists[2][corner]);
        EXPECT_EQ(first.VertexUVWMap()[vertex], lists[3][corner]);
        EXPECT_EQ(second.VertexUVWMap()[vertex], lists[4][corner]);
    }
}

TEST(VertexTable, AMapThatIsTooShortHasNoSay)
{
    const Ref<CTriMesh> mesh = Cube();
    mesh->m_apkUVWMap.emplace_back(new CTriMeshUVWMap);
    mesh->m_apkUVWMap[0]->SetTriangleQuantity(11);
    mesh->BuildVertexTable();
    EXPECT_EQ(mesh->GetVertexQuantity(), 24);
    EXPECT_TRUE(mesh->m_apkUVWMap[0]->VertexUVWMap().empty());
}

TEST(CTriMesh, SizingBelowOneKeepsWhatThereIs)
{
    const Ref<CTriMesh> mesh = FullMesh();
    COrrinStream stream;
    stream.AddRoot(mesh.Get());
    const std::string before = Describe(stream);
    for (const int32_t count : {0, -1})
    {
        EXPECT_FALSE(mesh->SetPointCount(count));
        EXPECT_FALSE(mesh->SetNormalCount(count));
        EXPECT_FALSE(mesh->SetColorCount(count));
        EXPECT_FALSE(mesh->SetTriangleQuantity(count));
    }
    EXPECT_EQ(Describe(stream), before);
    EXPECT_TRUE(mesh->SetTriangleQuantity(2));
    EXPECT_EQ(mesh->ColorTriIndexBuffer().size(), 6u);
    EXPECT_TRUE(mesh->VertexTriIndexBuffer().empty());
    EXPECT_TRUE(mesh->SmoothFlag().empty());
    EXPECT_TRUE(mesh->m_apkUVWMap.empty());
    EXPECT_TRUE(mesh->SetPointCount(3));
    EXPECT_TRUE(SurvivesRewriting(stream)) << "material ids are as many as points, or none";
}

TEST(CTriMesh, SizingWithoutMemoryKeepsWhatThereIs)
{
    const auto setters = {
        +[](CTriMesh& mesh) { return mesh.SetPointCount(99); },
        +[](CTriMesh& mesh) { return mesh.SetNormalCount(99); },
        +[](CTriMesh& mesh) { return mesh.SetColorCount(99); },
        +[](CTriMesh& mesh) { return mesh.SetTriangleQuantity(99); },
        +[](CTriMesh& mesh) { return mesh.m_apkUVWMap[0]->SetUVWCount(99); },
    };
    for (const auto set : setters)
    {
        const Ref<CTriMesh> mesh = FullMesh();
        COrrinStream stream;
        stream.AddRoot(mesh.Get());
        const std::string before = Describe(stream);
        int failed = 0;
        for (bool sized = false; !sized; ++failed)
        {
            EXPECT_EQ(Describe(stream), before);
            g_iAllocationsLeft = failed;
            sized = set(*mesh);
            g_iAllocationsLeft = -1;
        }
        EXPECT_GT(failed, 1) << "some allocation failed";
        EXPECT_NE(Describe(stream), before);
    }
}

TEST(WorldNormals, AreWeightedByAreaAndZeroWhereOnlyFlatTrianglesMeet)
{
    const Ref<CTriMesh> mesh = new CTriMesh;
    mesh->SetPointCount(5);
    mesh->SetNormalCount(4);
    mesh->SetTriangleQuantity(3);
    // Twice the area along z is 2, along x it is 1; the third triangle is degenerate.
    std::ranges::copy(std::vector<Vec3>{{0, 0, 0}, {2, 0, 0}, {0, 1, 0}, {0, 0, 1}, {1, 0, 0}},
                      mesh->XYZBuffer().begin());
    std::ranges::copy(std::vector<uint32_t>{0, 1, 2, 0, 2, 3, 0, 1, 4}, mesh->XYZTriIndexBuffer().begin());
    std::ranges::copy(std::vector<uint32_t>{0, 1, 1, 0, 2, 99, 3, 3, 3},
                      mesh->NormalTriIndexBuffer().begin());
    mesh->UpdateScene(0.0f, false);
    const std::span<Vec3> normals = mesh->WorldNormalBuffer();
    ExpectNear(normals[0], Vec3{1, 0, 2} * (1.0f / std::sqrt(5.0f)), 1e-6);
    ExpectNear(normals[1], kVec3UnitZ, 1e-6);
    ExpectNear(normals[2], kVec3UnitX, 1e-6);
    EXPECT_EQ(normals[3], kVec3Zero);

    mesh->XYZTriIndexBuffer()[4] = 99; // a triangle with an invalid point adds nothing
    mesh->UpdateScene(0.0f, false);
    ExpectNear(normals[0], kVec3UnitZ, 1e-6);
    EXPECT_EQ(normals[2], kVec3Zero);
}

TEST(CGeometry, UpdateRebuildsTheWorldCopyInItsMemory)
{
    const Ref<CTriMesh> mesh = Cube();
    mesh->m_kMatrix = Mat4Compose(Mat3FromAxisAngle(kVec3UnitZ, 1.57079632f), {10, 0, 0}, {2, 2, 2});
    mesh->UpdateScene(0.0f, false);
    const Vec3* const memory = mesh->WorldXYZBuffer().data();
    mesh->UpdateScene(0.0f, false);
    EXPECT_EQ(mesh->WorldXYZBuffer().data(), memory);
    ExpectNear(mesh->WorldXYZBuffer()[1], {10, 2, 0}, 1e-6);
    EXPECT_EQ(mesh->XYZBuffer()[1], kVec3UnitX);
    ExpectNear(mesh->m_kBound.m_kCentre, {9, 1, 1}, 1e-6);
    EXPECT_FLOAT_EQ(mesh->m_kBound.m_fRadius, std::sqrt(3.0f));
    for (size_t corner = 20; corner < 24; ++corner)
        ExpectNear(mesh->WorldNormalBuffer()[corner], kVec3UnitY, 1e-6); // the face along x, rotated
    mesh->UpdateRange(0, 0.0f);
    EXPECT_EQ(mesh->WorldXYZBuffer()[1], kVec3UnitX) << "points stay in model space";
    EXPECT_FALSE(mesh->m_bWorldValid);
}

TEST(CGeometry, AControlMayTakeThePointsOrTheNormalsOver)
{
    class CShift : public CTestControl
    {
    public:
        bool Update(float) override
        {
            CTriMesh& mesh = static_cast<CTriMesh&>(*GetTarget());
            mesh.WorldXYZBuffer()[0] = {100, 0, 0};
            mesh.m_bWorldValid = m_bWorld;
            mesh.m_bNormalsValid = m_bNormals;
            return true;
        }
        bool m_bWorld = false;
        bool m_bNormals = false;
    };
    const Ref<CTriMesh> mesh = Cube();
    CShift* shift = new CShift;
    shift->m_bAnswer = false;
    mesh->AttachControl(shift);
    mesh->m_kMatrix.SetTranslation({1, 0, 0});
    mesh->UpdateScene(0.0f, false);
    EXPECT_EQ(mesh->WorldXYZBuffer()[0], (Vec3{101, 0, 0})) << "moved in model space";
    shift->m_bWorld = true;
    mesh->UpdateScene(0.0f, false);
    EXPECT_EQ(mesh->WorldXYZBuffer()[0], (Vec3{100, 0, 0})) << "and in world space";

    const Vec3 own{0.5f, 0, 0};
    mesh->WorldNormalBuffer()[0] = own;
    shift->m_bNormals = true;
    mesh->UpdateScene(0.0f, false);
    EXPECT_EQ(mesh->WorldNormalBuffer()[0], own);
    shift->m_bNormals = false;
    mesh->m_bAutoNormals = false;
    mesh->UpdateScene(0.0f, false);
    EXPECT_EQ(mesh->WorldNormalBuffer()[0], own);
    EXPECT_TRUE(mesh->m_bNormalsValid);
}

TEST(CTriMesh, RenderAndStatesReachTheMeshesThatAreNotCulled)
{
    class CCount : public CRenderer
    {
    public:
        void DrawTriMesh(CTriMesh& mesh) override { m_kDrawn.push_back(&mesh); }
        std::vector<CTriMesh*> m_kDrawn;
    };
    const Ref<CNode> root = new CNode;
    CTriMesh* const shown = new CTriMesh;
    CTriMesh* const culled = new CTriMesh;
    culled->m_bForceCull = true;
    root->AttachChild(shown);
    root->AttachChild(culled);
    CCount count;
    root->Render(count);
    EXPECT_EQ(count.m_kDrawn, std::vector<CTriMesh*>{shown});
    root->AttachRenderState(*new CTestState(4));
    root->PushAndApply(nullptr);
    EXPECT_NE(culled->GetRenderState(4), nullptr);
    EXPECT_EQ(culled->GetRenderState(3), nullptr);
}

} // namespace gw
