#include "AttachBoneMeshes.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"

#include <gtest/gtest.h>

#include <cmath>
#include <set>
#include <tuple>

namespace gw {
namespace {

// Returns six times the volume enclosed by the triangles; positive if they face outward. Each edge must occur
// once in each direction.
double Volume(CTriMesh& mesh)
{
    std::set<std::pair<uint32_t, uint32_t>> edges;
    const auto index = mesh.XYZTriIndexBuffer();
    double volume = 0.0;
    for (size_t i = 0; i < index.size(); i += 3)
    {
        const Vec3 p[] = {mesh.XYZBuffer()[index[i]], mesh.XYZBuffer()[index[i + 1]],
                          mesh.XYZBuffer()[index[i + 2]]};
        volume += Vec3Dot(p[0], Vec3Cross(p[1], p[2]));
        for (size_t k = 0; k < 3; ++k)
            EXPECT_TRUE(edges.insert({index[i + k], index[i + (k + 1) % 3]}).second);
    }
    for (const auto& [from, to] : edges)
        EXPECT_TRUE(edges.contains({to, from}));
    return volume;
}

CNode* AddNode(CNode& parent, const Vec3& offset)
{
    CNode* child = new CNode;
    child->m_kMatrix.SetTranslation(offset);
    parent.AttachChild(child); // leaves a spare slot after every other child
    return child;
}

} // namespace

TEST(CBoneMesh, BallIsAClosedSphereOfItsSize)
{
    const Ref<CBoneNodeMesh> ball = new CBoneNodeMesh;
    ASSERT_TRUE(ball->Build(8.0f));
    EXPECT_EQ(ball->XYZBuffer().size(), 42u);
    EXPECT_EQ(ball->GetTriangleQuantity(), 80);
    for (const Vec3& point : ball->XYZBuffer())
        EXPECT_NEAR(Vec3Length(point), 1.0, 1e-5);
    EXPECT_NEAR(Volume(*ball) / 6.0, 3.66, 0.01); // an icosahedron has 2.54, a sphere 4.19
    EXPECT_NEAR(ball->XYZBuffer()[1].x, 8 * 0.1118f, 8e-5f);
    EXPECT_NEAR(ball->XYZBuffer()[1].z, 8 * 0.0559f, 8e-5f);
    const uint32_t begin[] = {0, 12, 13, 12, 1, 17, 12, 17, 13, 13, 17, 2};
    EXPECT_TRUE(std::ranges::equal(ball->XYZTriIndexBuffer().first(12), begin));
    EXPECT_EQ(ball->GetVertexQuantity(), 42);
}

TEST(CBoneMesh, TaperedBoneReachesToItsLengthAlongY)
{
    const Ref<CBoneShapeMesh> bone = new CBoneShapeMesh;
    EXPECT_EQ(bone->m_fLength, 0.0f);
    ASSERT_TRUE(bone->Build(4.0f));
    EXPECT_EQ(bone->XYZBuffer().size(), 6u);
    EXPECT_EQ(bone->XYZBuffer()[3], (Vec3{0, 4, 0}));
    EXPECT_GT(Volume(*bone), 0.0);
    for (const float refused : {0.0f, -1.0f})
        EXPECT_FALSE(bone->Build(refused));
    EXPECT_EQ(bone->m_fLength, 4.0f);
    ASSERT_TRUE(bone->Build(2.0f)) << "again";
    EXPECT_EQ(bone->XYZBuffer()[3], (Vec3{0, 2, 0}));
    EXPECT_EQ(bone->VertexTriIndexBuffer().size(), 24u);
}

TEST(BoneMeshQueries, AnswerForTheFirstBoneMeshAmongTheChildren)
{
    const Ref<CNode> node = new CNode;
    EXPECT_EQ(FindBoneMesh(*node), nullptr);
    EXPECT_EQ(NodeBoneLength(*node), 0.0f);
    EXPECT_EQ(NodeBoneAxis(*node), kVec3Zero);
    EXPECT_EQ(&NodeBoneWorld(*node), &node->m_kWorldMatrix);
    AddNode(*node, kVec3Zero)->AttachChild(new CBoneNodeMesh); // a child's own mesh does not count
    node->AttachChild(new CTriMesh);
    const Ref<CBoneShapeMesh> mesh = new CBoneShapeMesh;
    mesh->Build(3.0f);
    node->AttachChild(mesh.Get());
    EXPECT_EQ(FindBoneMesh(*node), mesh.Get());
    EXPECT_EQ(NodeBoneLength(*node), 3.0f);
    EXPECT_EQ(NodeBoneAxis(*node), kVec3UnitY);
    EXPECT_EQ(&NodeBoneWorld(*node), &mesh->m_kWorldMatrix);
}

TEST(AttachBoneMeshes, ABoneReachesToItsChildAndALeafIsAStump)
{
    EXPECT_TRUE(AttachBoneMeshes(nullptr));
    const Ref<CNode> hip = new CNode;
    hip->m_kMatrix.SetTranslation({0, 10, 0});
    CNode* knee = AddNode(*hip, {-3, 0, 4});
    CNode* ankle = AddNode(*knee, {5, 0, 0});
    CNode* still = AddNode(*ankle, kVec3Zero);
    ASSERT_TRUE(AttachBoneMeshes(hip.Get()));

    const std::tuple<const char*, const CNode*, float, Vec3> rows[] = {
        {"along z, whatever the sign of x", hip.Get(), 5.0f, kVec3UnitZ},
        {"along x", knee, 5.0f, kVec3UnitX},
        {"a child without offset leaves the length", ankle, 1.5f, kVec3UnitX},
        {"without offset of its own it stays empty", still, 0.0f, kVec3UnitY},
    };
    for (const auto& [what, node, length, way] : rows)
    {
        SCOPED_TRACE(what);
        CBoneMesh* mesh = FindBoneMesh(*node);
        ASSERT_NE(mesh, nullptr);
        EXPECT_EQ(mesh->GetRTTI(), &CBoneShapeMesh::ms_kRTTI);
        EXPECT_FLOAT_EQ(mesh->m_fLength, length);
        const Vec3 along = TransformCoord(mesh->Axis(), mesh->m_kMatrix);
        EXPECT_NEAR(Vec3Dot(along, way), 1.0, 1e-6);
    }
    EXPECT_EQ(FindBoneMesh(*still)->GetTriangleQuantity(), 0);
}

TEST(AttachBoneMeshes, BranchesAreBallsThatTheirLastChildSizes)
{
    const Ref<CNode> hip = new CNode;
    AddNode(*hip, {2, 0, 0});
    AddNode(*hip, {0, 3, 0});               // Y dominates: the previous child's rotation is kept
    CNode* last = AddNode(*hip, {4, 4, 0}); // nothing dominates
    AddNode(*last, {-1, 0, 0});
    hip->AttachChild(new CBillboardNode); // a derived class is not a bone
    AttachBoneMeshes(hip.Get());
    const CBoneMesh* mesh = FindBoneMesh(*hip);
    EXPECT_EQ(mesh->GetRTTI(), &CBoneNodeMesh::ms_kRTTI);
    EXPECT_FLOAT_EQ(mesh->m_fLength, std::sqrt(32.0f));
    EXPECT_NEAR(TransformCoord(kVec3UnitY, mesh->m_kMatrix).x, 1.0f, 1e-6f);
    EXPECT_NEAR(TransformCoord(kVec3UnitY, FindBoneMesh(*last)->m_kMatrix).x, 1.0f, 1e-6f);
    EXPECT_EQ(FindBoneMesh(static_cast<CNode&>(*hip->ChildAt(3))), nullptr);
}

} // namespace gw
