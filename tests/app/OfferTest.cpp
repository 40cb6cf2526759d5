// What the window offers: stories of a person who does what it says.

#include "ContentFixture.h"

#include "CProfileEditorDialog.h"
#include "Paths.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <thread>

namespace gw {
namespace {

using testing::HasSubstr;

const SourceBones kOtherBones{"rig:Hips",       "rig:LeftUpLeg", "rig:LeftLeg",  "rig:LeftFoot",
                              "rig:RightUpLeg", "rig:RightLeg",  "rig:RightFoot"};

std::vector<ERemedy> RemediesOf(const std::vector<Offer>& offers)
{
    std::vector<ERemedy> remedies(offers.size());
    std::ranges::transform(offers, remedies.begin(), &Offer::remedy);
    return remedies;
}

size_t MappedCount(const CBoneTree& tree)
{
    size_t count = 0;
    for (int item = 0; item < static_cast<int>(tree.Items().size()); ++item)
        count += tree.IsMapped(item) ? 1 : 0;
    return count;
}

class Offers : public ContentTest
{
protected:
    Offers()
    {
        Write("data/Other.prf", BoneMapText("Other", kOtherBones));
        Write("walk.bvh", BvhText(kPoserBones));
        Write("other.bvh", BvhText(kOtherBones));
        Write("strange.bvh", BvhText({"a", "b", "c", "d", "e", "f", "g"}));
        m_kContent.RefreshProfileList();
    }
};

} // namespace

TEST_F(Offers, TheMapThatFitsIsOneStepAway)
{
    m_kContent.UpdateControls();
    EXPECT_THAT(m_kWindow.m_kHints["#cnt1"].text, HasSubstr("Ctrl+O"));
    Do("open other.bvh");
    EXPECT_THAT(m_kWindow.m_kHints["#cnt2"].text, HasSubstr("Fits best"));
    EXPECT_EQ(*m_kWindow.m_kList.GetItemText(0), "Other");
    EXPECT_THAT(m_kWindow.m_kList.ItemWords(0), HasSubstr("best fit"));
    EXPECT_EQ(m_kWindow.m_kList.ItemWords(1), "") << "shares no bone with the source";
    m_kContent.TakeOffer();
    EXPECT_EQ(SelectedProfile(), "Other");
    EXPECT_THAT(m_kWindow.m_kHints["#cnt2"].text, HasSubstr("Convert (Ctrl+Return)"));
    Do("click convert");
    EXPECT_TRUE(m_kContent.IsConverted());
    EXPECT_EQ(m_kWindow.m_kHints["#cnt2"].text, "");
}

TEST_F(Offers, AFailedConversionIsSavedByTheMapThatFits)
{
    Do("open walk.bvh, open other.bvh");
    EXPECT_THAT(m_kWindow.m_kHints["#cnt2"].text, HasSubstr("Poser does not fit: "));
    m_kWindow.m_kNotices.clear();
    Do("click convert");
    EXPECT_EQ(RemediesOf(m_kContent.OffersFor(m_kWindow.m_kNotices)), std::vector{ERemedy::UseMap});
    const std::string summary = SummaryOf(m_kWindow.m_kNotices);
    EXPECT_EQ(std::ranges::count(summary, '\n'), 4) << summary; // three bones, and the number of the others
    EXPECT_THAT(summary, testing::EndsWith("and 4 more"));
    m_kContent.RunRemedy(ERemedy::UseMap);
    EXPECT_TRUE(m_kContent.IsConverted());

    m_kWindow.m_kAnswers[139] = EAnswer::No;
    Do("open strange.bvh");
    EXPECT_EQ(RemediesOf(m_kWindow.m_kHints["#cnt2"].offers), std::vector{ERemedy::DraftMap});
    m_kContent.TakeOffer();
    EXPECT_THAT(m_kWindow.m_kHints["#cnt2"].text, HasSubstr("none can be drafted"));
    EXPECT_TRUE(m_kWindow.m_kHints["#cnt2"].offers.empty());
}

TEST_F(Offers, OnlyTheBonesOfTheChosenMapAreMarked)
{
    Write("both.bvh", BvhText({"hip", "lThigh", "lShin", "lFoot", "R_Thigh", "R_Calf", "R_Foot"}));
    Do("open both.bvh, select Poser");
    const CBoneTree& bones = m_kContent.ProfileEditor()->SourceTree();
    EXPECT_EQ(MappedCount(bones), 4u);
    SelectProfile("3DS MAX");
    EXPECT_EQ(MappedCount(bones), 3u);
}

TEST_F(Offers, TheResultSaysHowItWasMade)
{
    Do("open walk.bvh");
    EXPECT_EQ(m_kWindow.m_kTexts["source"], "walk.bvh: 3 frames at 30 fps, plays at double speed");
    EXPECT_EQ(m_kWindow.m_kTexts["result"], "Result");
    m_kWindow.m_kKeys = {EKey::LeftShift};
    Do("click convert");
    const std::string made = "Made with \"Poser\", feet not planted";
    EXPECT_EQ(m_kWindow.m_kTexts["#resultNote"], made);
    m_kContent.SetChoices({.align = true});
    EXPECT_EQ(m_kWindow.m_kTexts["#resultNote"], made + "; settings have changed since");
    SaveAs("takes.Kinetra");
    EXPECT_EQ(m_kWindow.m_kAsked.fileName, "walk");
    EXPECT_THAT(m_kWindow.m_kTexts["result"], HasSubstr("takes.Kinetra: "));
    SaveAs("takes.Kinetra");
    EXPECT_EQ(m_kWindow.m_kAsked.fileName, "takes") << "where it was saved before";
}

TEST_F(Offers, ALongStepIsCanceledWithNothingHalfDone)
{
    Write("long.bvh", BvhText(kPoserBones, 5000));
    Do("open walk.bvh, click convert");
    Write("take.Kinetra", "old");
    m_kWindow.m_bProgressDue = m_kWindow.m_bCancel = true;
    m_kWindow.TakeWords();
    m_kWindow.m_kAnswers[139] = EAnswer::No;
    SaveAs("take.Kinetra");
    EXPECT_EQ(Read("take.Kinetra"), "old");
    EXPECT_FALSE(m_kContent.IsSaved());
    const CNode* const source = m_kContent.SourceRoot();
    Do("open long.bvh");
    EXPECT_EQ(m_kContent.SourceRoot(), source);
    EXPECT_EQ(m_kWindow.TakeWords(), "139");
    EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0");

    m_kWindow.m_bCancel = false;
    Do("open long.bvh, click convert");
    const CNode* const result = m_kContent.ResultMotion().motionRoot.Get();
    m_kWindow.m_bCancel = true;
    Do("click convert");
    EXPECT_EQ(m_kContent.ResultMotion().motionRoot.Get(), result) << "the result before stays";
    while (m_kContent.UpdateMarks())
        std::this_thread::yield();
    EXPECT_EQ(m_kWindow.m_iMarkedFrames, 5000) << "and so do its marks";
}

TEST_F(Offers, AFileThatReadsBadlyIsOpenedAsAMendedCopy)
{
    std::string text = BvhText(kPoserBones);
    text.insert(text.find("Frames:"), 1, '\n');
    m_kWindow.m_bShowsFindings = true;
    EXPECT_EQ(Open(Write("broken.bvh", text)), 0);
    EXPECT_EQ(RemediesOf(m_kContent.OffersFor(m_kWindow.m_kNotices)), std::vector{ERemedy::OpenMendedCopy});
    Write("broken (mended).bvh", "of somebody else");
    m_kContent.RunRemedy(ERemedy::OpenMendedCopy);
    EXPECT_EQ(m_kContent.RecentFiles().front(), m_kFolder.Path("broken (mended) 2.bvh"));
    EXPECT_EQ(Read("broken (mended).bvh"), "of somebody else");
}

} // namespace gw
