// A profile applied to two skeletons: look-ups by name, the retargeter's tables, and how well a file fits.
#include "ProfileFixture.h"

#include "CRetargeter.h"
#include "FindBone.h"
#include "ProfileFit.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {

using testing::ElementsAre;

namespace {

std::string Describe(const MissingBone& bone)
{
    const char* side = bone.side == ESkeletonSide::Source ? " source " : " target ";
    return std::to_string(bone.line) + side + bone.name + ' ' + bone.nearest;
}

} // namespace

TEST_F(ProfileEditor, ApplyingFillsTheTablesWithWhatDiffers)
{
    Load("N\nA x LowerTorso 0,0,0,1,2,3\nB x Waist 10,-20,30,1,2,3\nc x HEAD 0,0,0,-1,3,2\n");
    CRetargeter retargeter;
    int matched = -1;
    int total = -1;
    EXPECT_TRUE(m_kEditor.ApplyProfile(&retargeter, &matched, &total));
    EXPECT_EQ(matched, 5);
    EXPECT_EQ(total, 5) << "fixed rows count here";
    CNode* hip = FindBone(m_spkTarget.Get(), "LowerTorso");
    CNode* waist = FindBone(m_spkTarget.Get(), "Waist");
    CNode* head = FindBone(m_spkTarget.Get(), "Head");
    EXPECT_EQ(retargeter.SourceOf(hip), FindBone(m_spkSource.Get(), "A"));
    EXPECT_EQ(retargeter.SourceOf(head), FindBone(m_spkSource.Get(), "C"));
    EXPECT_EQ(retargeter.OffsetAngles(hip), kVec3Zero);
    EXPECT_EQ(retargeter.OffsetAngles(waist), (Vec3{10, -20, 30}));
    EXPECT_EQ(retargeter.OffsetMatrix(waist), kMat3Identity);
    EXPECT_EQ(retargeter.OffsetMatrix(head), AxisMatrix({-1, 3, 2}));
    bool fixed = false;
    EXPECT_TRUE(retargeter.IsFixed(FindBone(m_spkTarget.Get(), "LPelvis"), fixed) && fixed);
    EXPECT_FALSE(retargeter.IsFixed(head, fixed));

    Load("N\nB x Head 0\n");
    m_kEditor.ApplyProfile(&retargeter, nullptr, nullptr);
    EXPECT_EQ(retargeter.SourceOf(hip), nullptr) << "nothing of the profile before is left";
}

TEST_F(ProfileEditor, OneMissingBoneFailsTheProfileAndSparesTheOtherRows)
{
    const std::tuple<const char*, const char*, const char*, bool> rows[] = {
        {"source missing", "None x LowerTorso 0\nA x Head 0\n", "3 of 4, misfit", true},
        {"target missing", "B x None 0\nA x Head 0\n", "3 of 4, misfit", false},
        {"fixed target missing", "* None . .1,2,3\nA x Head 0\n", "3 of 4, misfit", false},
        {"all there, no root", "A x Head 0\n", "3 of 3, fits", false},
        {"fixed root counts", "* lowertorso . .1,2,3\nA x Head 0\n", "4 of 4, fits", true},
    };
    for (const auto& [what, lines, verdict, rootMapping] : rows)
    {
        m_kEditor.LoadProfile(MakeProfile(std::string("N\n") + lines));
        m_kEditor.RebuildSourceTree();
        EXPECT_EQ(Apply(), verdict) << what;
        EXPECT_EQ(m_kEditor.HasRootMapping(), rootMapping) << what;
        EXPECT_TRUE(m_kEditor.SourceTree().IsMapped(m_kEditor.FindSourceItem("A"))) << what;
    }
}

TEST_F(ProfileEditor, ApplyingClampsTheFieldsAndStoresNothing)
{
    Load("N\nFrameRate 10\n");
    EXPECT_TRUE(m_kEditor.ApplyProfile(nullptr, nullptr, nullptr)) << "a table without misfits";
    EXPECT_THAT(m_kOwner.TakeMessages(), ElementsAre("157 30 240"));
    EXPECT_EQ(m_kEditor.FieldText(kFrameRateField), "30");
    EXPECT_EQ(m_kEditor.GetFrameRate(), 10);

    CProfileEditorDialog noScenes(m_kOwner);
    int total = -1;
    EXPECT_FALSE(noScenes.ApplyProfile(nullptr, nullptr, &total));
    EXPECT_EQ(total, -1);
}

TEST(FindBone, ExactNameFirstThenAnyCase)
{
    const Ref<CNode> root = MakeChain({"hips", "Hips", "Spine", "SPINE"});
    CNode* second = static_cast<CNode*>(root->ChildAt(0));
    EXPECT_EQ(FindBone(root.Get(), "hips"), root.Get());
    EXPECT_EQ(FindBone(root.Get(), "Hips"), second);
    EXPECT_EQ(FindBone(root.Get(), "HIPS"), root.Get()) << "the first in search order";
    EXPECT_EQ(FindBone(root.Get(), "spine")->NameView(), "Spine");
    EXPECT_EQ(FindBone(root.Get(), "none"), nullptr);
    EXPECT_EQ(FindBone(nullptr, "hips"), nullptr);
    second->SetName(nullptr);
    EXPECT_EQ(FindBone(root.Get(), ""), nullptr) << "no name is not an empty name";
}

TEST(BoneTree, ShowsEachNameOnceBelowItsParent)
{
    const Ref<CNode> root = MakeChain({"Hips", "Spine", "hips", "Head"});
    auto* spine = static_cast<CNode*>(root->ChildAt(0));
    spine->AttachChild(MakeChain({"Arm"}).Get());
    CBoneTree tree(4);
    tree.Rebuild(root.Get());
    ASSERT_EQ(tree.Items().size(), 4u);
    EXPECT_EQ(tree.RootItems(), std::vector<int>{0});
    EXPECT_EQ(tree.Items()[1].m_kChildren, std::vector<int>{3}) << "Arm";
    EXPECT_EQ(tree.Items()[0].m_kChildren, (std::vector<int>{1, 2}))
        << "Head hangs on the item with its parent's name";
    EXPECT_EQ(tree.Text(2), "Head");

    tree.Select(tree.Find("HEAD"));
    tree.Mark(2, true);
    tree.Mark(-1, true);
    tree.Mark(99, true);
    EXPECT_EQ(tree.SelectedText(), "Head");
    EXPECT_EQ(tree.Image(0) + 10 * tree.SelectedImage(0), 20);
    EXPECT_EQ(tree.Image(2) + 10 * tree.SelectedImage(2), 34);

    spine->SetName(nullptr);
    tree.Rebuild(root.Get());
    EXPECT_EQ(tree.Selected(), CBoneTree::kNone);
    EXPECT_EQ(tree.RootItems().size(), 2u) << "Arm has no named parent, Head has the first hips";
}

TEST(ProfileFit, NamesTheSideTheLineAndTheNearestBone)
{
    const CTempFolder folder;
    const Ref<CNode> source = MakeChain({"Hips", "LeftUpLeg"});
    const Ref<CNode> target = MakeChain({"LowerTorso", "LThigh", "RThigh", "LPelvis"});
    const std::string path = folder.Path("a.prf");
    WriteBytes(path, "Fit\nFrameRate 60\nHip x LowerTorso 0\nLeftUpLeg x LThigh 0\nelse x LTHIGH 0\n"
                     "* Rthig . .1,2,3\nqqqqqqqq x Unknown 0\n");
    CProfileFit fit;
    ASSERT_TRUE(MeasureFit(path, source.Get(), target.Get(), fit));
    std::vector<std::string> missing;
    for (const MissingBone& bone : fit.missing)
        missing.push_back(Describe(bone));
    EXPECT_THAT(missing, ElementsAre("3 source Hip Hips", "6 target Rthig RThigh", "7 source qqqqqqqq ",
                                     "7 target Unknown ", "0 target RPelvis LPelvis"));
    EXPECT_EQ(fit.name, "Fit");
    EXPECT_EQ(fit.rowCount, 6) << "four targets of the file and the two pelvis bones";
    EXPECT_FALSE(MeasureFit(folder.Path("none.prf"), source.Get(), target.Get(), fit));
    EXPECT_EQ(fit.foundCount, 2) << "left alone";
}

TEST_F(ProfileEditor, MeasuredFitAgreesWithApplying)
{
    const std::tuple<const char*, bool> rows[] = {
        {"A x LowerTorso 0\n", true},          {"* LowerTorso . .1,2,3\n", false},
        {"a x Head 0\nB x head 0\n\n", false}, {"None x LowerTorso 0\nA x LPelvis 0\n", false},
        {"\n* RPelvis\n* None\n", false},
    };
    for (const auto& [lines, drivesRoot] : rows)
    {
        Load(std::string("N\nFrameRate 30\n") + lines);
        CProfileFit fit;
        MeasureFit(m_kEditor.ProfilePath(), m_spkSource.Get(), m_spkTarget.Get(), fit);
        const char* verdict = fit.missing.empty() ? ", fits" : ", misfit";
        EXPECT_EQ(Apply(), std::to_string(fit.foundCount) + " of " + std::to_string(fit.rowCount) + verdict);
        EXPECT_EQ(fit.drivesRoot, drivesRoot) << lines;
    }
    EXPECT_EQ(MeasureFit(m_kEditor.Rows(), m_spkSource.Get(), m_spkTarget.Get()).missing.size(), 1u);
}

} // namespace gw
