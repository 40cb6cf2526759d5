#include "ControlSamples.h"
#include "SceneBytes.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

// Adds the part that is common to all controls, without a target.
CSceneBytes& Control(CSceneBytes& bytes, std::string_view className)
{
    bytes.Root().Object(className, 1).Word(1).Float(2).Float(3).Float(4).Float(5).Byte(1).Words({0, 0});
    return bytes;
}

} // namespace

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
    scene = nullptr; // deletes the bone and the other mesh too
    mesh->UpdateScene(1.5f, true);
    mesh->UpdateScene(2.5f, true);
    const auto& skin = static_cast<const CBoneSkinControl&>(*mesh->GetControl());
    EXPECT_FALSE(skin.Bones()[0].m_pkBone);
}

} // namespace gw
