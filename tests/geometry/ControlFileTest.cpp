#include "ControlSamples.h"
#include "SceneBytes.h"

#include <gtest/gtest.h>

namespace gw {

namespace {

// What every control adds, without a target.
CSceneBytes& Control(CSceneBytes& bytes, std::string_view className)
{
    bytes.Root().Object(className, 1).Word(1).Float(2).Float(3).Float(4).Float(5).Byte(1).Words({0, 0});
    return bytes;
}

// A root of a class with the bytes of its own fields behind those of its base.
template <class T, class F>
Ref<T> LoadControl(F own)
{
    CSceneBytes bytes = Scene();
    own(Control(bytes, T::ms_kRTTI.m_pcName));
    COrrinStream stream;
    EXPECT_TRUE(LoadBytes(stream, bytes.Bytes())) << T::ms_kRTTI.m_pcName;
    EXPECT_EQ(SaveBytes(stream), bytes.Bytes()) << T::ms_kRTTI.m_pcName;
    return static_cast<T*>(stream.GetRoot(0));
}

} // namespace

TEST(ControlFile, EveryClassHasItsFieldsInTheOrderOfTheFile)
{
    const auto morph = LoadControl<CMorphControl>(
        [](auto& b) { b.Word(1).Add(kVec3UnitX).Words({2}).Float(7).Float(8).Word(1).Float(9); });
    EXPECT_EQ(morph->m_kDeltas, std::vector{kVec3UnitX});
    EXPECT_EQ(morph->m_kWeights, (std::vector{7.0f, 8.0f}));
    EXPECT_EQ(morph->m_kKeyTimes, std::vector{9.0f});
    EXPECT_EQ(morph->m_fFrequency, 5.0f);

    const auto frames =
        LoadControl<CTriMeshUVWMapControl>([](auto& b) { b.Word(1).Add(kVec3UnitY).Word(1).Float(6); });
    EXPECT_EQ(frames->m_kFrames, std::vector{kVec3UnitY});
    EXPECT_EQ(frames->m_kKeyTimes, std::vector{6.0f});

    const auto selection = LoadControl<CMeshSelControl>([](auto& b) {
        b.Words({40, 2, 1, 0x80000000u, 0xffffu});
    });
    EXPECT_TRUE(selection->m_kSelection.Test(31));
    EXPECT_FALSE(selection->m_kSelection.Test(30));
    EXPECT_TRUE(selection->m_kSelection.Test(39));
    EXPECT_FALSE(selection->m_kSelection.Test(40)) << "set in its word and behind the count";

    const auto skin = LoadControl<CBoneSkinControl>([](auto& b) {
        b.Words({1, 0}).Add(Moved(1, 2, 3)).Words({1, 4}).Float(0.5f);
    });
    EXPECT_EQ(skin->Bones()[0].m_kOffset, Moved(1, 2, 3));
    EXPECT_EQ(skin->Bones()[0].m_kInfluences[0].SkinID, 4u);
    EXPECT_EQ(skin->Bones()[0].m_kInfluences[0].SkinWeight, 0.5f);

    const auto byPoint = LoadControl<CSkinBoneControl>([](auto& b) {
        b.Words({1, 8, 1, 0}).Float(0.25f).Add(Moved(4, 5, 6));
    });
    EXPECT_EQ(byPoint->Points()[0].m_uiIndex, 8u);
    EXPECT_EQ(byPoint->Points()[0].m_kEntries[0].m_fWeight, 0.25f);
    EXPECT_EQ(byPoint->Points()[0].m_kEntries[0].m_kOffset, Moved(4, 5, 6));

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

    const auto particles = LoadControl<CParticleControl>([](auto& b) {
        b.Word(100);
        for (float value = 1; value < 38; ++value)
            b.Float(value);
        b.Words({50, 51, 52, 53});
    });
    EXPECT_EQ(particles->m_uiCapacity, 100u);
    EXPECT_EQ(particles->m_fGrowth, 1.0f);
    EXPECT_EQ(particles->m_kForceDirection, (Vec3{2, 3, 4}));
    EXPECT_EQ(particles->m_fForceStrength, 5.0f);
    EXPECT_EQ(particles->m_kDirection, (Vec3{6, 7, 8}));
    EXPECT_EQ(particles->m_fRate, 9.0f);
    EXPECT_EQ(particles->m_kPlace.m_kMaximum, (Vec3{10, 11, 12}));
    EXPECT_EQ(particles->m_kVelocity.m_kMinimum, (Vec3{19, 20, 21}));
    EXPECT_EQ(particles->m_afSecondColor[0], 26.0f);
    EXPECT_EQ(particles->m_kSpread.m_kMaximum, (Vec3{30, 31, 32}));
    EXPECT_EQ(particles->m_fSize, 37.0f);
    EXPECT_EQ(particles->m_auiFurther[3], 53u);
}

TEST(ControlFile, WhatControlsShareHasItsFieldsInTheOrderOfTheFile)
{
    CSceneBytes bytes = Scene();
    bytes.Root().Object("CConnectData", 1).Words({0, 0, 1, 11, 2, 21, 22, 1, 1, 31, 2, 0, 1, 41});
    bytes.Root().Object("CEditNormalData", 2).Words({1, 0, 3, 1, 1, 5}).Byte(0).Float(0.5f);
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
    EXPECT_EQ(SaveBytes(stream), bytes.Bytes());
    const auto& seam = static_cast<const CConnectData&>(*stream.GetRoot(0));
    EXPECT_EQ(seam.m_kFirst.m_kPoints, std::vector{11u});
    EXPECT_EQ(seam.m_kSecond.m_kPoints, (std::vector{21u, 22u}));
    EXPECT_EQ(seam.m_kFirst.m_kGroups[0], std::vector{31u});
    EXPECT_EQ(seam.m_kSecond.m_kGroups[1], std::vector{41u});
    const auto& smoothing = static_cast<const CEditNormalData&>(*stream.GetRoot(1));
    EXPECT_TRUE(smoothing.m_kMeshes[0].m_kNormals.Test(2));
    EXPECT_FALSE(smoothing.m_bEnabled);
    EXPECT_EQ(smoothing.m_fThreshold, 0.5f);
}

TEST(ControlFile, ASceneOfAllClassesComesBackByCloneAndByFile)
{
    const Ref<CNode> scene = ControlledScene();
    COrrinStream stream;
    stream.AddRoot(scene.Get());
    ASSERT_TRUE(SurvivesRewriting(stream));
    uint64_t size = 58 + 14;
    for (const CObject* object : stream.ObjectsInSaveOrder())
        size += object->GetDiskUsed();
    EXPECT_EQ(SaveBytes(stream).size(), size);

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
    COrrinStream stream;
    const Ref<CNode> scene = ControlledScene();
    stream.AddRoot(scene.Get());
    const std::vector<std::byte> whole = SaveBytes(stream);
    for (const uint32_t word : {0xffffffffu, 0x7f800000u, 0x00010000u, 0u})
    {
        for (size_t at = 58; at + 4 <= whole.size(); ++at)
        {
            std::vector<std::byte> bytes = whole;
            std::memcpy(bytes.data() + at, &word, 4);
            COrrinStream damaged;
            if (!damaged.LoadBuffer(bytes, 0))
                continue;
            CNode* root = RecordCast<CNode>(damaged.GetRoot(0));
            if (!root)
                continue;
            root->UpdateScene(1.5f, true);
            root->UpdateScene(2.5f, true);
        }
    }
    for (size_t end = 58; end < whole.size(); ++end)
    {
        COrrinStream cut;
        const bool loaded = LoadBytes(cut, std::span(whole).first(end));
        ASSERT_EQ(loaded, !cut.Record().Failure()) << end;
    }
}

TEST(ControlFile, MeshesAndBonesThatDieLeaveNothingBehind)
{
    Ref<CNode> scene = ControlledScene();
    const Ref<CTriMesh> mesh = static_cast<CTriMesh*>(scene->ChildAt(0));
    scene = nullptr; // takes the bone and the other mesh along
    mesh->UpdateScene(1.5f, true);
    mesh->UpdateScene(2.5f, true);
    const auto& skin = static_cast<const CBoneSkinControl&>(*mesh->GetControl());
    EXPECT_FALSE(skin.Bones()[0].m_pkBone);
}

} // namespace gw
