// Clicks, timers, the scroll bar and help.

#include "ContentFixture.h"
#include "ResourceFile.h"

#include "CProfileEditorDialog.h"

#include <tuple>

namespace gw {

using Calls = std::vector<std::string>;

TEST_F(ContentTest, Clicks)
{
    m_kWindow.m_kAnswers[171] = EAnswer::Cancel;
    OpenAndConvert();
    const std::tuple<const char*, Calls, bool> rows[] = {
        {"close", {"close"}, false},         {"EXIT", {"close"}, false}, {"play", {"timer 0 17"}, true},
        {"play1", {"timer 1 100"}, true},    {"PreFrm1", {}, true},      {"NextFrm1", {}, true},
        {"apply", {"save *.Kinetra"}, true}, {"nothing", {}, true},
    };
    for (const auto& [child, calls, passedOn] : rows)
    {
        SCOPED_TRACE(child);
        m_kWindow.TakeCalls();
        EXPECT_EQ(m_kContent.ChildClick(child), passedOn);
        EXPECT_EQ(m_kWindow.TakeCalls(), calls);
    }
}

TEST_F(ContentTest, TheClockRunsBothViewsUntilTheSourceStops)
{
    OpenAndConvert();
    m_kContent.ChildClick("play");
    EXPECT_EQ(m_kWindow.m_iPlayFace, 1);
    m_kWindow.TakeCalls();
    m_kContent.OnTimer(0);
    EXPECT_GT(m_kWindow.m_pkSource->GetTime(), 0.0f);
    EXPECT_GT(m_kWindow.m_pkResult->GetTime(), 0.0f);
    EXPECT_EQ(m_kWindow.m_iScrollValue, 128);
    m_kContent.OnTimer(0); // the last of three frames ends it
    EXPECT_EQ(m_kWindow.TakeCalls(), Calls{"kill 0"});
    EXPECT_EQ(m_kWindow.m_iPlayFace, 0);
}

TEST_F(ContentTest, TheResultsOwnTimerMovesNothing)
{
    OpenAndConvert();
    m_kContent.ChildClick("play1");
    m_kContent.OnTimer(1);
    EXPECT_EQ(m_kWindow.m_pkResult->GetTime(), 0.0f);
    EXPECT_TRUE(m_kWindow.m_pkResult->IsPlaying());
    m_kContent.ChildClick("stop1");
    m_kWindow.TakeCalls();
    m_kContent.OnTimer(1);
    EXPECT_EQ(m_kWindow.TakeCalls(), Calls{"kill 1"});
}

TEST_F(ContentTest, SelectedBonesAreHighlighted)
{
    Open(Write("walk.bvh", BvhText(kPoserBones)));
    CProfileEditorDialog& editor = *m_kContent.ProfileEditor();
    editor.SelectSourceItem(editor.FindSourceItem("lShin"));
    editor.SelectTargetItem(editor.FindTargetItem("LCalf"));
    EXPECT_EQ(m_kWindow.m_pkSource->m_kHighlight, "lShin");
    EXPECT_EQ(m_kWindow.m_pkResult->m_kHighlight, "LCalf");
}

TEST_F(ContentTest, HelpIsTheHostsFileOrAPage)
{
    const std::string page = "web https://tessarine.example/gaitwright?lang=deu";
    const auto click = [this] {
        m_kContent.ChildClick("help");
        return m_kWindow.TakeCalls();
    };
    m_kPlatform.m_uiLocale = 1031;
    EXPECT_EQ(click(), (Calls{"box 137", page})) << "no host product";
    m_kPlatform.m_kHostKeys["Software\\Tessarine\\Kestro\\2.0/Main Program"] = m_kFolder.Path("host/Kestro");
    EXPECT_EQ(click(), Calls{page}) << "a host without its library";
    Write("host/Kbel.dll", ResourceFile({}));
    EXPECT_EQ(click(), Calls{"help ::/Using_Gaitwright.htm"}) << "a library that names no file";
    Write("host/Kbel.dll", ResourceFile({{32824, 0, u"Kestro.chm"}}));
    EXPECT_EQ(click(), Calls{page}) << "a file that is not there";
    Write("host/Kestro.chm", "");
    EXPECT_EQ(click(), Calls{"help " + m_kFolder.Path("host/Kestro.chm::/Using_Gaitwright.htm")});
}

TEST_F(ContentTest, AMissingViewIsReportedAndNothingElseStops)
{
    class CBlindWindow : public CScriptedWindow
    {
        std::unique_ptr<CMotionView> CreateView(std::string_view) override { return nullptr; }
    };
    CBlindWindow window;
    CGaitConvertContent content(window, m_kPlatform);
    EXPECT_FALSE(content.OnInitContent());
    window.openAnswer = Write("walk.bvh", BvhText(kPoserBones));
    EXPECT_EQ(content.OpenSource(), 1);
    EXPECT_EQ(content.ConvertMotion(), 1);
    for (const char* child : {"play", "stop", "end", "play1", "end1"})
        content.ChildClick(child);
    content.OnTimer(0);
    EXPECT_TRUE(content.WriteResult(m_kFolder.Path("blind.Kinetra")));
}

} // namespace gw
