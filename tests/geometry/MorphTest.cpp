#include "MeshSamples.h"
#include "Rotations.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

CMorphControl& AttachMorph(CTriMesh& mesh, const std::vector<Vec3>& deltas)
{
    CMorphControl* morph = new CMorphControl;
    mesh.AttachControl(morph);
    morph->m_fEndTime = 10.0f;
    morph->m_kDeltas = deltas;
    morph->m_kWeights = {0.0f, 2.0f, 0.0f};
    morph->m_kKeyTimes = {0.0f, 4.0f, 8.0f};
    return *morph;
}

} // namespace

TEST(Morph, MovesTheModelByTheWeightOfTheTime)
{
    const Ref<CTriMesh> mesh = PointMesh({kVec3Zero, kVec3UnitX});
    mesh->m_kMatrix = Mat4Compose(Mat3FromAxisAngle(kVec3UnitZ, 1.57079632f), {0, 0, 5});
    CMorphControl& morph = AttachMorph(*mesh, {kVec3UnitX}); // fewer deltas than points
    const std::tuple<const char*, float, float> rows[] = {
        {"before the first key", -1, 0}, {"between", 1, 0.5f}, {"on a key", 4, 2}, {"back", 6, 1},
        {"behind the last", 9, 0},
    };
    for (const auto& [what, time, weight] : rows)
    {
        SCOPED_TRACE(what);
        const uint32_t stamp = mesh->m_uiChangeStamp;
        mesh->UpdateScene(time, false);
        ExpectNear(mesh->WorldXYZBuffer()[0], {0, weight, 5}, 1e-5);
        ExpectNear(mesh->WorldXYZBuffer()[1], {0, 1, 5}, 1e-5);
        EXPECT_EQ(mesh->m_uiChangeStamp - stamp, weight == 0 ? 0u : 1u);
    }
    AttachMorph(*mesh, {kVec3UnitY, kVec3UnitY});
    mesh->UpdateScene(4.0f, false);
    ExpectNear(mesh->WorldXYZBuffer()[0], {-2, 2, 5}, 1e-5);
    morph.m_bActive = false;
    mesh->UpdateScene(4.0f, false);
    ExpectNear(mesh->WorldXYZBuffer()[0], {-2, 0, 5}, 1e-5);
}

TEST(Morph, BehindASkinTheOffsetTurnsWithTheMeshAndDoesNotMoveIt)
{
    const Ref<CNode> bone = new CNode;
    bone->m_kWorldMatrix = Moved(7, 0, 0);
    const Ref<CTriMesh> mesh = PointMesh({kVec3UnitZ});
    mesh->m_kMatrix = Mat4Compose(Mat3FromAxisAngle(kVec3UnitZ, 1.57079632f), {100, 100, 100}, {3, 1, 1});
    CBoneSkinControl* skin = new CBoneSkinControl;
    mesh->AttachControl(skin);
    skin->AddInfluence(*bone, 0, 1.0f, kMat4Identity);
    skin->RebuildSkinTables();
    AttachMorph(*mesh, {kVec3UnitX});
    mesh->UpdateScene(4.0f, false);
    ExpectNear(mesh->WorldXYZBuffer()[0], {7, 6, 1}, 1e-5);
}

TEST(Morph, AnswersByWhatItIsAndHas)
{
    const Ref<CMorphControl> morph = new CMorphControl;
    EXPECT_TRUE(morph->Update(0.0f)) << "nothing to do";
    morph->m_kWeights = {1.0f};
    morph->m_kKeyTimes = {0.0f};
    EXPECT_FALSE(morph->Update(0.0f)) << "no target";
    Ref<CNode>(new CNode)->AttachControl(morph.Get());
    EXPECT_FALSE(morph->Update(0.0f)) << "a target of another class";
}

TEST(TextureFrames, ShowTheFrameOfTheKeyBeforeWithoutBlending)
{
    const Ref<CTriMesh> mesh = Triangle();
    CTriMeshUVWMap* map = new CTriMeshUVWMap;
    mesh->m_apkUVWMap.emplace_back(map);
    mesh->m_apkUVWMap.emplace_back();
    map->SetUVWCount(2);
    CTriMeshUVWMapControl* frames = new CTriMeshUVWMapControl;
    map->AttachControl(frames);
    frames->m_fEndTime = 10.0f;
    frames->m_kFrames = {kVec3UnitX, kVec3UnitY, kVec3UnitZ, kVec3One, {5, 5, 5}}; // two and a half
    const auto first = [&](float time) {
        mesh->UpdateScene(time, false);
        return map->UVWBuffer()[0];
    };
    EXPECT_EQ(first(0.0f), kVec3Zero) << "no key times";
    EXPECT_EQ(map->m_uiChangeStamp, 1u);
    frames->m_kKeyTimes = {0.0f, 2.0f, 4.0f};
    EXPECT_EQ(first(1.9f), kVec3UnitX);
    EXPECT_EQ(map->UVWBuffer()[1], kVec3UnitY);
    EXPECT_EQ(first(3.0f), kVec3UnitZ);
    EXPECT_EQ(first(5.0f), kVec3UnitZ) << "the last frame that is whole";
    frames->m_bActive = false;
    EXPECT_EQ(first(0.0f), kVec3UnitZ);
    EXPECT_FALSE(frames->Update(0.0f));
    frames->m_bActive = true;
    map->DetachControls();
    EXPECT_FALSE(Ref<CTriMeshUVWMapControl>(new CTriMeshUVWMapControl)->Update(0.0f)) << "no target";
}

TEST(CBitArray, BitsThatAreNotThereAreNotSet)
{
    CBitArray bits(33);
    bits.Set(0);
    bits.Set(32);
    bits.Set(33);
    for (const size_t bit : {0u, 1u, 31u, 32u, 33u, 63u, 1000u})
        EXPECT_EQ(bits.Test(bit), bit == 0 || bit == 32) << bit;
    bits.Clear(32);
    bits.Clear(1000);
    EXPECT_FALSE(bits.Test(32));
    EXPECT_FALSE(CBitArray(-5).Test(0));
}

} // namespace gw
