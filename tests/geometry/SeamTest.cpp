#include "MeshSamples.h"
#include "Rotations.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace gw {
namespace {

const float kDiagonal = std::sqrt(0.5f);

// Two triangles: one faces +Z, the other is 2 to the right and faces +X.
class TwoMeshes : public testing::Test
{
protected:
    void SetUp() override
    {
        m_kSecond->m_kMatrix = Mat4Compose(Mat3FromAxisAngle(kVec3UnitY, 1.57079632f), {2, 0, 0});
        m_kRoot->AttachChild(m_kFirst.Get());
        m_kRoot->AttachChild(m_kSecond.Get());
    }
    template <class TControl, class TData>
    void Attach(Held<TData> TControl::*data, TData* shared)
    {
        for (CTriMesh* mesh : {m_kFirst.Get(), m_kSecond.Get()})
        {
            TControl* control = new TControl;
            control->*data = shared;
            control->m_fEndTime = 10.0f;
            mesh->AttachControl(control);
        }
    }
    void AttachSeam()
    {
        m_kSeam->m_kFirst.m_pkMesh.Set(m_kFirst.Get());
        m_kSeam->m_kSecond.m_pkMesh.Set(m_kSecond.Get());
        m_kSeam->m_kFirst.m_kPoints = {0};
        m_kSeam->m_kSecond.m_kPoints = {0};
        m_kSeam->m_kFirst.m_kGroups = {{0, 99}};
        m_kSeam->m_kSecond.m_kGroups = {{0}};
        Attach(&CConnectControl::m_spkConnectData, m_kSeam.Get());
    }
    void AttachSmoothing(float threshold)
    {
        m_kSmoothing->m_fThreshold = threshold;
        m_kSmoothing->m_kMeshes.resize(2);
        m_kSmoothing->m_kMeshes[0].m_pkMesh.Set(m_kFirst.Get());
        m_kSmoothing->m_kMeshes[1].m_pkMesh.Set(m_kSecond.Get());
        for (CEditNormalData::Record& record : m_kSmoothing->m_kMeshes)
        {
            record.m_kNormals = CBitArray(3);
            record.m_kNormals.Set(0);
            record.m_kNormals.Set(1);
        }
        Attach(&CEditNormalControl::m_spkEditNormalData, m_kSmoothing.Get());
    }
    void Update(float time) { m_kRoot->UpdateScene(time, false); }

    Ref<CNode> m_kRoot = new CNode;
    Ref<CTriMesh> m_kFirst = Triangle();
    Ref<CTriMesh> m_kSecond = Triangle();
    Ref<CConnectData> m_kSeam = new CConnectData;
    Ref<CEditNormalData> m_kSmoothing = new CEditNormalData;
};

} // namespace

TEST_F(TwoMeshes, ASeamClosesWhenTheSecondMeshHasReachedTheTime)
{
    AttachSeam();
    m_kFirst->UpdateTransform(1.0f);
    m_kFirst->Update(1.0f);
    EXPECT_EQ(m_kFirst->WorldXYZBuffer()[0], kVec3Zero) << "the other is not there yet";
    const uint32_t stamp = m_kFirst->m_uiChangeStamp;
    Update(1.0f);
    ExpectNear(m_kFirst->WorldXYZBuffer()[0], {1, 0, 0}, 1e-4);
    ExpectNear(m_kSecond->WorldXYZBuffer()[0], {1, 0, 0}, 1e-4);
    ExpectNear(m_kFirst->WorldXYZBuffer()[1], {1, 0, 0}, 1e-4);
    for (CTriMesh* mesh : {m_kFirst.Get(), m_kSecond.Get()})
        ExpectNear(mesh->WorldNormalBuffer()[0], {kDiagonal, 0, kDiagonal}, 1e-4);
    ExpectNear(m_kFirst->WorldNormalBuffer()[1], kVec3UnitZ, 1e-4);
    EXPECT_GT(m_kFirst->m_uiChangeStamp, stamp);
}

TEST_F(TwoMeshes, ASeamStaysOpenForOtherTimesAndForASideThatIsOff)
{
    AttachSeam();
    CControl& control = *m_kSecond->GetControl();
    control.m_fPhase = 1.0f;
    Update(2.0f);
    ExpectNear(m_kFirst->WorldXYZBuffer()[0], kVec3Zero, 1e-4);
    control.m_fPhase = 0.0f;
    control.m_bActive = false;
    Update(5.0f);
    ExpectNear(m_kFirst->WorldXYZBuffer()[0], kVec3Zero, 1e-4);
    control.m_bActive = true;
    Update(5.0f);
    ExpectNear(m_kFirst->WorldXYZBuffer()[0], {1, 0, 0}, 1e-4);
}

TEST_F(TwoMeshes, APointNamedTwiceMovesTwiceAndOneThatIsNotThereNever)
{
    AttachSeam();
    m_kSeam->m_kFirst.m_kPoints = {0, 0, 99, 1};
    m_kSeam->m_kSecond.m_kPoints = {0, 0, 1};
    m_kSecond->m_kMatrix = Moved(4, 0, 0);
    m_kSeam->m_kSecond.m_kPoints[1] = 1; // at 5
    Update(1.0f);
    ExpectNear(m_kFirst->WorldXYZBuffer()[0], {3.5f, 0, 0}, 1e-4);
    ExpectNear(m_kSecond->WorldXYZBuffer()[0], {2, 0, 0}, 1e-4);
    ExpectNear(m_kSecond->WorldXYZBuffer()[1], {3.5f, 0, 0}, 1e-4);
}

TEST_F(TwoMeshes, NormalsAreSmoothedWhereOtherMeshesAreNear)
{
    AttachSmoothing(1.25f);
    // The first mesh's normal 1 is at (1, 0, 0), the second's 0 at (2, 0, 0); all others are farther apart.
    Update(1.0f);
    ExpectNear(m_kFirst->WorldNormalBuffer()[0], kVec3UnitZ, 1e-4);
    ExpectNear(m_kFirst->WorldNormalBuffer()[1], {kDiagonal, 0, kDiagonal}, 1e-4);
    ExpectNear(m_kSecond->WorldNormalBuffer()[0], {kDiagonal, 0, kDiagonal}, 1e-4);
    ExpectNear(m_kSecond->WorldNormalBuffer()[2], kVec3UnitX, 1e-4); // not selected

    m_kSmoothing->m_fThreshold = 1.0f; // strictly below
    Update(2.0f);
    ExpectNear(m_kFirst->WorldNormalBuffer()[1], kVec3UnitZ, 1e-4);
}

TEST_F(TwoMeshes, ASelectedNormalThatNoCornerNamesBecomesZero)
{
    AttachSmoothing(0.1f);
    m_kFirst->NormalTriIndexBuffer()[1] = 0;
    Update(1.0f);
    ExpectNear(m_kFirst->WorldNormalBuffer()[0], kVec3UnitZ, 1e-4);
    EXPECT_EQ(m_kFirst->WorldNormalBuffer()[1], kVec3Zero);
}

// Compares the literal rule, over every pair, with the result of the cells.
TEST(Smoothing, CellsFindWhatIsNearAndNothingElse)
{
    struct Corner
    {
        Vec3 place;
        Vec3 normal;
    };
    std::mt19937 random(3);
    std::uniform_real_distribution<float> place(-4.0f, 4.0f);
    const Ref<CEditNormalData> smoothing = new CEditNormalData;
    smoothing->m_fThreshold = 0.75f;
    smoothing->m_kMeshes.resize(3);
    std::vector<Ref<CTriMesh>> meshes;
    std::vector<Corner> corners; // 99 of each mesh
    for (CEditNormalData::Record& record : smoothing->m_kMeshes)
    {
        const Ref<CTriMesh>& mesh = meshes.emplace_back(PointMesh(std::vector<Vec3>(99)));
        mesh->SetNormalCount(99);
        mesh->SetTriangleQuantity(33);
        record.m_pkMesh.Set(mesh.Get());
        record.m_kNormals = CBitArray(99);
        for (uint32_t corner = 0; corner < 99; ++corner)
        {
            mesh->XYZBuffer()[corner] = {place(random), place(random), place(random) * 0.1f};
            mesh->XYZTriIndexBuffer()[corner] = mesh->NormalTriIndexBuffer()[corner] = corner;
            record.m_kNormals.Set(corner);
        }
        mesh->UpdateScene(0.0f, false);
        for (size_t corner = 0; corner < 99; ++corner)
            corners.push_back({mesh->WorldXYZBuffer()[corner], mesh->WorldNormalBuffer()[corner]});
    }
    EXPECT_TRUE(smoothing->Update(0.0f));
    for (size_t i = 0; i < corners.size(); ++i)
    {
        Vec3 sum = corners[i].normal;
        for (size_t k = 0; k < corners.size(); ++k)
        {
            if (k / 99 != i / 99 && Vec3Length(corners[i].place - corners[k].place) < 0.75)
                sum = sum + corners[k].normal;
        }
        ExpectNear(meshes[i / 99]->WorldNormalBuffer()[i % 99], Vec3Normalized(sum), 1e-4);
    }
    meshes[1]->m_bNormalsValid = false;
    EXPECT_FALSE(smoothing->Update(0.0f)) << "one mesh is behind";
}

} // namespace gw
