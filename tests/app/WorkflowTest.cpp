// Opening, converting, discarding: the four states and their transitions.

#include "ContentFixture.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CFileConversion.h"
#include "CProfileEditorDialog.h"
#include "FindBone.h"
#include "Paths.h"
#include "SourceTiming.h"

#include <algorithm>
#include <filesystem>
#include <tuple>

namespace gw {

TEST_F(ContentTest, ControlsFollowTheState)
{
    Write("walk.bvh", BvhText(kPoserBones));
    Write("still.bvh", BvhText(kPoserBones, 0));
    Write("other.bvh", BvhText({"a", "b", "c", "d", "e", "f", "g"}));
    const std::string open = "convert end fend play %adv |playbar";
    const std::string converted = open + " apply";
    const std::tuple<const char*, const char*, std::string> rows[] = {
        {"nothing is open", "", ""},
        {"no stock profile fits", "open other.bvh", "play end fend |playbar"},
        {"a source without keys", "open still.bvh", "%adv"},
        {"a stock profile fits", "open walk.bvh", open},
        {"the source plays", "click play", open + " stop"},
        {"at its end", "click play, click end", "play back fback convert %adv |playbar"},
        {"back at its start", "click back", open},
        {"converted", "click convert", converted + " play1 end1 NextFrm1"},
        {"the result plays", "click play1", converted + " stop1 end1 NextFrm1"},
        {"at its end", "click stop1, click END1", converted + " play1 start1 PreFrm1"},
        {"a custom profile", "select Mine", converted + " play1 start1 PreFrm1 del"},
    };
    for (const auto& [what, steps, enabled] : rows)
    {
        SCOPED_TRACE(what);
        Do(steps);
        EXPECT_EQ(m_kWindow.Enabled(), Words(enabled));
        EXPECT_EQ(m_kWindow.m_iWaits, 0);
    }
}

TEST_F(ContentTest, ApplyKeepsItsStateUntilTheUpdateAfterAnOpen)
{
    OpenAndConvert();
    m_kWindow.m_kAnswers[139] = EAnswer::No;
    Open(m_kFolder.Path("walk.bvh"));
    EXPECT_TRUE(m_kWindow.m_kEnabled["apply"]);
    m_kContent.UpdateControls();
    EXPECT_FALSE(m_kWindow.m_kEnabled["apply"]);
}

TEST_F(ContentTest, DiscardQuestion)
{
    // saves: whether the save dialog is answered with a path
    const std::tuple<const char*, EAnswer, bool, bool, bool> rows[] = {
        {"cancel keeps the result", EAnswer::Cancel, false, false, false},
        {"no drops it", EAnswer::No, false, true, false},
        {"yes saves it", EAnswer::Yes, true, true, true},
        {"yes and then cancel loses it", EAnswer::Yes, false, true, false},
    };
    OpenAndConvert();
    for (const auto& [what, answer, saves, opened, saved] : rows)
    {
        SCOPED_TRACE(what);
        const std::string path = m_kFolder.Path("kept.Kinetra");
        DeleteFile(path);
        m_kWindow.m_kAnswers[139] = answer;
        m_kWindow.saveAnswer = saves ? std::optional(path) : std::nullopt;
        EXPECT_EQ(Open(m_kFolder.Path("walk.bvh")), opened ? 1 : 0);
        EXPECT_EQ(m_kContent.IsConverted(), !opened);
        EXPECT_EQ(Exists("kept.Kinetra"), saved);
        if (opened)
            m_kContent.ConvertMotion();
    }
}

TEST_F(ContentTest, NothingIsAskedWhenNothingWouldBeLost)
{
    OpenAndConvert();
    SaveAs("out.Kinetra");
    m_kContent.ConvertMotion(); // a second conversion after a save counts as saved
    m_kWindow.TakeCalls();
    EXPECT_TRUE(m_kContent.ConfirmDiscard());
    EXPECT_TRUE(m_kWindow.TakeCalls().empty());
}

TEST_F(ContentTest, OpeningTellsTheFolderAndReadsItBack)
{
    m_kWindow.openAnswer = std::nullopt;
    EXPECT_EQ(m_kContent.OpenSource(), 1) << "a cancelled dialog is no failure";
    Open(Write("deep/walk.bvh", BvhText(kPoserBones)));
    EXPECT_EQ(SourceRateOf(m_kContent.SourceRoot()), 30) << "the nearest rate, which is above 29.999";
    m_kWindow.TakeCalls();
    m_kContent.OpenSource();
    EXPECT_EQ(m_kWindow.TakeCalls().front(), "open *.bvh in " + m_kFolder.Path("deep/"));
}

TEST_F(ContentTest, AFailedOpenKeepsTheSource)
{
    const std::string container = WriteContainer("scene.orn");
    const std::string whole = Read("scene.orn");
    Write("cut.orn", whole.substr(0, whole.size() - 9));
    WriteContainer("still.orn", false);
    Write("words.bvh", "hello\n");
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"no such file", "none.bvh", "not-found, 138"},
        {"no motion in it", "words.bvh", "missing-section HIERARCHY, 138"},
        {"a container without track", "still.orn", "no-track, 138"},
        {"a container cut short", "cut.orn", "truncated CKeyframeControl, 138"},
    };
    Open(Write("walk.bvh", BvhText(kPoserBones)));
    const CNode* root = m_kContent.SourceRoot();
    m_kWindow.TakeCalls();
    for (const auto& [what, file, words] : rows)
    {
        SCOPED_TRACE(what);
        EXPECT_EQ(Open(m_kFolder.Path(file)), 0);
        EXPECT_EQ(m_kContent.SourceRoot(), root);
        EXPECT_EQ(m_kWindow.TakeWords(), words);
        EXPECT_EQ(m_kWindow.m_iWaits, 0);
    }
    EXPECT_EQ(Open(container), 1);
}

TEST_F(ContentTest, AContainerStaysTheSourceUntilABatchRuns)
{
    ASSERT_EQ(Open(WriteContainer("scene.orn")), 1);
    EXPECT_EQ(m_kWindow.m_pkSource->GetLastFrame(), 1.0f);
    const CNode* scene = m_kContent.SourceRoot();
    ASSERT_EQ(Open(Write("only/walk.bvh", BvhText(kPoserBones))), 1);
    EXPECT_EQ(m_kContent.SourceRoot(), scene);
    EXPECT_EQ(m_kWindow.m_pkSource->m_spkShown.Get(), scene);

    m_kWindow.folderAnswer = FolderChoice{m_kFolder.Path("only/"), 1};
    m_kContent.RunBatch();
    EXPECT_NE(m_kContent.SourceRoot(), scene);
}

TEST_F(ContentTest, AContainerConverts)
{
    Write("data/MaxBVH.prf", "3DS MAX\nhip <---> LowerTorso 0,0,0\n");
    ASSERT_EQ(Open(WriteContainer("scene.orn")), 1);
    EXPECT_EQ(m_kContent.ConvertMotion(), 1);
    EXPECT_EQ(m_kContent.ResultMotion().GetLastFrame(), 1.0f);

    CFileConversion alone(m_kFolder.Path("data/"), {}, [](const Notice&) {});
    ASSERT_TRUE(alone.LoadSource(m_kFolder.Path("scene.orn")));
    EXPECT_TRUE(FindBoneMesh(*alone.SourceRoot())) << "without a window too: it tells how the bone points";
    ASSERT_TRUE(alone.LoadTarget());
    const CNode* const root = FindBone(alone.Result().motionRoot.Get(), "LowerTorso");
    EXPECT_FALSE(FindBoneMesh(*root)->XYZBuffer().empty()) << "the lowest point is put on the floor";
}

TEST_F(ContentTest, AProfileThatDoesNotFitStopsTheConversion)
{
    const std::tuple<const char*, const char*> rows[] = {
        {"lThigh <---> LThigh 0\n", "no-root-row, 144"},
        {"* LowerTorso . .1,2,3\n", "no-root-source, 144"},
        {"hip <---> LowerTorso 0\nhop <---> LThigh 0\n", "misfit, 144"},
    };
    OpenAndConvert();
    for (const auto& [lines, words] : rows)
    {
        m_kContent.UseProfileFile(Write("docs/BVH Profile/Custom1.prf", std::string("Odd\n") + lines));
        m_kWindow.TakeCalls();
        EXPECT_EQ(m_kContent.ConvertMotion(), 0);
        EXPECT_EQ(m_kWindow.TakeWords(), words);
        EXPECT_TRUE(m_kContent.IsConverted()) << "the flag keeps its value";
    }
}

TEST_F(ContentTest, ShiftLeavesTheLegsOutAndNothingElse)
{
    OpenAndConvert();
    const auto section = [this](const char* file, const char* bone) {
        const std::string text = Read(file);
        const size_t begin = text.find(bone);
        return text.substr(begin, text.find("\n[", begin) - begin);
    };
    SaveAs("with.htr");
    m_kWindow.m_kKeys = {EKey::LeftShift};
    m_kContent.ConvertMotion();
    SaveAs("without.htr");
    EXPECT_EQ(section("with.htr", "[LowerTorso]"), section("without.htr", "[LowerTorso]"));
    EXPECT_NE(section("with.htr", "[LThigh]"), section("without.htr", "[LThigh]"));
    EXPECT_NE(section("without.htr", "[LCalf]").find("\n1 0.000000 0.000000 0.000000 0.000000 "),
              std::string::npos)
        << "straight as the source's knee is in the first frame";
}

TEST_F(ContentTest, EveryConversionStartsFromTheTargetAsItIsOnTheDisk)
{
    const std::string base = m_kFolder.Path("data/base.htr");
    std::string text = ReadBytes(base);
    const size_t offset = text.find("RThigh -95") + 8;
    Write("walk.bvh", BvhText(kPoserBones));
    for (const bool isReplaced : {false, true}) // by a new file of equal size and time, or in place
    {
        SCOPED_TRACE(isReplaced);
        const std::filesystem::file_time_type before{std::chrono::hours(1)};
        std::filesystem::last_write_time(base, before);
        Do("open walk.bvh");
        text[offset] = isReplaced ? '6' : '7';
        const std::string written = Write(isReplaced ? "next.htr" : "data/base.htr", text);
        if (isReplaced)
            std::filesystem::last_write_time(written, before);
        std::filesystem::rename(written, base);
        for (const char* name : {"first.htr", "second.htr"})
        {
            m_kContent.ConvertMotion();
            SaveAs(name);
        }
        EXPECT_NE(Read("first.htr").find("RThigh -" + text.substr(offset, 2)), std::string::npos);
        EXPECT_EQ(Read("first.htr"), Read("second.htr"));
    }
}

TEST_F(ContentTest, AConversionTakesTheRowsAsTheyStandAndGoesBackToTheStart)
{
    OpenAndConvert();
    SaveAs("saved rows.htr");
    CProfileEditorDialog& editor = *m_kContent.ProfileEditor();
    editor.SelectOnlyRow(1);
    editor.ClickRow(1);
    editor.ClickButton(kRemoveButton);
    Do("click end");
    EXPECT_GT(m_kWindow.m_pkSource->GetTime(), 0.0f);
    m_kContent.ConvertMotion();
    EXPECT_EQ(m_kWindow.m_pkSource->GetTime(), 0.0f);
    SaveAs("unsaved rows.htr");
    EXPECT_TRUE(editor.IsDirty());
    EXPECT_NE(Read("unsaved rows.htr"), Read("saved rows.htr"));
}

TEST_F(ContentTest, TheRestPoseStandsWhereTheMotionBegins)
{
    OpenAndConvert();
    const CNode* root = FindBone(m_kContent.ResultMotion().restRoot.Get(), "LowerTorso");
    ASSERT_NE(root, nullptr);
    EXPECT_EQ(root->m_kMatrix.Translation(), kRootPosition);
    EXPECT_EQ(m_kWindow.m_pkResult->m_spkShown, m_kContent.ResultMotion().motionRoot);
}

TEST_F(ContentTest, WithoutATargetSkeletonTheSourceStillShows)
{
    DeleteFile(m_kFolder.Path("data/base.htr"));
    EXPECT_EQ(Open(Write("walk.bvh", BvhText(kPoserBones))), 1);
    EXPECT_NE(m_kWindow.m_pkSource->m_spkShown, nullptr);
    EXPECT_FALSE(m_kWindow.m_kEnabled["convert"]);
    ASSERT_FALSE(m_kWindow.m_kNotices.empty());
    EXPECT_EQ(m_kWindow.m_kNotices.front().path, m_kFolder.Path("data/base.htr"));
}

TEST_F(ContentTest, ClosingAsksTheEditorFirst)
{
    OpenAndConvert();
    SelectProfile("Mine");
    m_kContent.ProfileEditor()->MarkChanged();
    m_kWindow.TakeCalls();
    m_kWindow.m_kAnswers = {{161, EAnswer::No}, {139, EAnswer::Cancel}};
    EXPECT_FALSE(m_kContent.MayClose());
    EXPECT_EQ(m_kWindow.TakeCalls(), (std::vector<std::string>{"box 161", "box 139"}));
}

TEST_F(ContentTest, DropsAndRecentFilesOpenAsTheDialogDoes)
{
    const std::string walk = Write("walk.bvh", BvhText(kPoserBones));
    const std::string profile = Write("Mine.prf", BoneMapText("Dropped", kPoserBones));
    EXPECT_EQ(m_kContent.OpenDropped(m_kFolder.Path("gone.bvh")), 0);
    EXPECT_TRUE(m_kContent.RecentFiles().empty());
    EXPECT_EQ(m_kContent.OpenDropped(walk), 1);
    EXPECT_EQ(m_kContent.OpenDropped(profile), 1);
    EXPECT_EQ(SelectedProfile(), "Dropped");
    EXPECT_EQ(m_kContent.OpenDropped(m_kFolder.Path("data")), 0) << "asks for the folder, which is cancelled";
    for (int i = 0; i < 9; ++i)
        m_kContent.OpenFile(Write("walk" + std::to_string(i) + ".bvh", BvhText(kPoserBones)));
    m_kContent.OpenFile(walk);
    ASSERT_EQ(m_kContent.RecentFiles().size(), 9u);
    EXPECT_EQ(std::ranges::count(m_kPlatform.m_kSettings["RecentFiles"], '\n'), 9);
    EXPECT_EQ(m_kContent.RecentFiles().front(), walk);
    EXPECT_EQ(m_kContent.RecentFiles().back(), m_kFolder.Path("walk1.bvh"));
    m_kContent.OpenFile(walk);
    EXPECT_EQ(m_kContent.RecentFiles()[1], m_kFolder.Path("walk8.bvh")) << "once, however often it is opened";

    Do("click convert");
    m_kWindow.m_kAnswers[139] = EAnswer::Cancel;
    EXPECT_EQ(m_kContent.OpenDropped(walk), 0);
    EXPECT_TRUE(m_kContent.IsConverted());
}

TEST_F(ContentTest, LongStepsTellTheirProgressInTheTitle)
{
    Write("walk.bvh", BvhText(kPoserBones, 200));
    WriteContainer("scene.orn");
    m_kWindow.saveAnswer = m_kFolder.Path("walk.Kinetra");
    Do("open walk.bvh");
    m_kWindow.m_bProgressDue = true;
    const std::tuple<const char*, const char*> rows[] = {
        {"click convert", "Gaitwright v2.0 - Converting 32 % (Esc cancels)"},
        {"click apply", "Gaitwright v2.0 - Saving 49 % (Esc cancels)"},
        {"open scene.orn", "Gaitwright v2.0 - Opening 100 % (Esc cancels)"},
    };
    for (const auto& [step, title] : rows)
    {
        m_kWindow.m_kTitles.clear();
        Do(step);
        EXPECT_EQ(std::ranges::count(m_kWindow.m_kTitles, title), 1)
            << step << ": " << testing::PrintToString(m_kWindow.m_kTitles);
        EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0");
    }
}

} // namespace gw
