// The map tool, from loading motions to saving a result.

#include "CGaitToolDialog.h"

#include "ContentFixture.h"
#include "Paths.h"

#include <algorithm>
#include <filesystem>
#include <regex>

namespace gw {

namespace {

/// A window that answers from a script.
class CScriptedToolWindow : public CToolWindow
{
public:
    std::optional<std::string> AskOpenFile(const CFileDialogSetup& setup) override { return Ask(setup); }
    std::optional<std::string> AskSaveFile(const CFileDialogSetup& setup) override { return Ask(setup); }
    bool EditLine(CMapLine& line) override
    {
        m_kEdited = line;
        return m_kOnEdit && (m_kOnEdit(line), true);
    }
    std::unique_ptr<CMotionView> CreateView(EToolMotion motion) override
    {
        auto view = std::make_unique<CWatchedView>();
        m_pkViews[static_cast<size_t>(motion)] = view.get();
        return view;
    }
    void CloseWindow() override { m_bClosed = true; }

    CWatchedView& View(EToolMotion motion) { return *m_pkViews[static_cast<size_t>(motion)]; }

    std::optional<std::string> m_kAnswer;
    CFileDialogSetup m_kAsked;
    std::function<void(CMapLine&)> m_kOnEdit; ///< what the user changes before OK; cancels without
    CMapLine m_kEdited;
    bool m_bClosed = false;

private:
    std::optional<std::string> Ask(const CFileDialogSetup& setup)
    {
        m_kAsked = setup;
        return m_kAnswer;
    }

    CWatchedView* m_pkViews[3] = {};
};

constexpr const char* kHead = "Unknown Source|Position 0,0,0|FrameRate 60|";

class ToolTest : public ContentTest
{
protected:
    ToolTest() { m_kTool.OnInitDialog(); }

    void Click(int id, const std::string& file = {})
    {
        m_kToolWindow.m_kAnswer = file.empty() ? std::nullopt : std::optional(m_kFolder.Path(file));
        m_kTool.ClickButton(id);
    }
    /// Loads a walk of some frames.
    void LoadSource(int frameCount = 3)
    {
        Write("walk.bvh", BvhText(kPoserBones, frameCount));
        Click(kToolLoadSource, "walk.bvh");
    }
    /// Loads a map with these lines, each ended by "|".
    void LoadMap(std::string lines)
    {
        std::ranges::replace(lines, '|', '\n');
        Write("map.txt", lines);
        Click(kToolLoadMap, "map.txt");
    }
    std::string Lines() const
    {
        std::string text;
        for (const CMapLine& line : m_kTool.Map().Lines())
            text += line.text + '|';
        return text;
    }
    void Add(const char* source, const char* target)
    {
        m_kTool.SelectSourceItem(m_kTool.SourceTree().Find(source));
        m_kTool.SelectTargetItem(m_kTool.TargetTree().Find(target));
        Click(kToolAddToMap);
    }
    /// The bones that carry a marker: "hip lThigh > LowerTorso".
    std::string Marked() const
    {
        return MarkedOf(m_kTool.SourceTree()) + '>' + MarkedOf(m_kTool.TargetTree());
    }
    std::set<int> Enabled() const
    {
        std::set<int> ids;
        for (int id :
             {kToolClose, kToolLoadSource, kToolLoadTarget, kToolAddToMap, kToolDelete, kToolDeleteAll,
              kToolLoadMap, kToolSaveMap, kToolConvert, kToolSaveResult, kToolDetail})
        {
            if (m_kTool.IsEnabled(id))
                ids.insert(id);
        }
        return ids;
    }
    CNode* Bone(EToolMotion motion, const char* name) const
    {
        CNode* const root = m_kTool.Motion(motion).motionRoot.Get();
        return root ? static_cast<CNode*>(root->FindObject(name, &CNode::ms_kRTTI, true)) : nullptr;
    }
    /// Where a bone of the result stands in a frame.
    Mat4 ResultAt(const char* name, int frame)
    {
        m_kToolWindow.View(EToolMotion::Result).SeekStart();
        for (int step = 0; step < frame; ++step)
            m_kToolWindow.View(EToolMotion::Result).StepForward();
        return Bone(EToolMotion::Result, name)->m_kWorldMatrix;
    }

    /// Where all bones of the result stand, frame by frame.
    std::vector<Mat4> ResultPoses()
    {
        std::vector<Mat4> poses;
        for (int frame = 0; frame <= m_kTool.LastFrameOf(EToolMotion::Result); ++frame)
        {
            for (const CBoneTree::Item& bone : m_kTool.TargetTree().Items())
                poses.push_back(ResultAt(bone.m_kText.c_str(), frame));
        }
        return poses;
    }

    CScriptedToolWindow m_kToolWindow;
    CGaitToolDialog m_kTool{m_kToolWindow, m_kPlatform};

private:
    static std::string MarkedOf(const CBoneTree& tree)
    {
        std::string names;
        for (size_t item = 0; item < tree.Items().size(); ++item)
        {
            if (tree.IsMapped(static_cast<int>(item)))
                names += ' ' + tree.Items()[item].m_kText + ' ';
        }
        return names;
    }
};

const std::string kMap =
    "Walk|Position 1,2,3|FrameRate 30|hip <---> LowerTorso .|lThigh <---> LThigh 10,20,30|"
    "* LPelvis . .1,2,3|rThigh <---> RThigh .|lFoot <---> LFoot .|rFoot <---> RFoot .|";

} // namespace

TEST_F(ToolTest, ASourceBringsTheFixedSkeletonAlong)
{
    LoadSource();
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Anm Files (*.bvh;*.htr) |*.bvh;*.htr||");
    EXPECT_EQ(m_kToolWindow.m_kAsked.defaultExtension, "htr");
    EXPECT_EQ(m_kTool.SourceTree().Items().size(), 7u);
    EXPECT_EQ(m_kTool.TargetTree().Items().front().m_kText, "LowerTorso");
    for (const EToolMotion motion : kToolMotions)
        EXPECT_EQ(m_kToolWindow.View(motion).m_spkShown, m_kTool.Motion(motion).motionRoot);
    EXPECT_NE(Bone(EToolMotion::Target, "LFoot"), Bone(EToolMotion::Result, "LFoot")) << "two trees";
    EXPECT_EQ(m_kTool.LastFrameOf(EToolMotion::Source), 2);
    EXPECT_EQ(m_kTool.Status(), "walk.bvh: 3 frames");
}

TEST_F(ToolTest, WhatDoesNotLoadLeavesTheMotionBefore)
{
    LoadSource();
    Add("hip", "LowerTorso");
    const std::string lines = Lines();
    const auto* const before = m_kTool.Motion(EToolMotion::Source).motionRoot.Get();
    Write("bad.bvh", "HIERARCHY\nROOT hip\n{\n");
    Write("bad.htr", "no header");
    for (const char* file : {"bad.bvh", "bad.htr", "none.bvh", "map.orn"})
    {
        SCOPED_TRACE(file);
        Click(kToolLoadSource, file);
        EXPECT_EQ(m_kTool.Status().find(file), 0u) << m_kTool.Status();
        Click(kToolLoadTarget, file);
        EXPECT_EQ(m_kTool.Status().find(file), 0u) << m_kTool.Status();
        EXPECT_FALSE(m_kTool.DropFile(EToolMotion::Source, m_kFolder.Path(file)));
        EXPECT_EQ(m_kTool.Motion(EToolMotion::Source).motionRoot.Get(), before);
        EXPECT_EQ(Lines(), lines);
    }
}

TEST_F(ToolTest, ButtonsTakeClicksWhenTheyCanDoSomething)
{
    const std::set<int> always{kToolClose, kToolLoadSource, kToolLoadTarget};
    EXPECT_EQ(Enabled(), always);
    Click(kToolAddToMap);
    Click(kToolConvert);
    EXPECT_FALSE(m_kTool.IsConverted()) << "a disabled button does nothing";

    Click(kToolLoadTarget, "data/base.htr");
    std::set<int> withTarget = always;
    withTarget.insert(kToolSaveResult);
    EXPECT_EQ(Enabled(), withTarget) << "before any conversion";

    LoadSource();
    std::set<int> withTrees = withTarget;
    withTrees.insert({kToolAddToMap, kToolLoadMap});
    EXPECT_EQ(Enabled(), withTrees);
    Click(kToolAddToMap);
    EXPECT_EQ(Lines(), "") << "without a bone selected in both trees";

    Add("hip", "LowerTorso");
    std::set<int> withLines = withTrees;
    withLines.insert({kToolDelete, kToolDeleteAll, kToolSaveMap, kToolConvert});
    EXPECT_EQ(Enabled(), withLines);
    m_kTool.SelectLine(0);
    EXPECT_TRUE(m_kTool.IsEnabled(kToolDetail));
    Click(kToolClose);
    EXPECT_TRUE(m_kToolWindow.m_bClosed);
}

TEST_F(ToolTest, AddedLinesStandBehindTheHead)
{
    LoadSource();
    Add("hip", "LowerTorso");
    Add("lThigh", "LThigh");
    EXPECT_EQ(Lines(), std::string(kHead) + "hip <---> LowerTorso .|lThigh <---> LThigh .|");
    EXPECT_EQ(Marked(), " hip  lThigh > LowerTorso  LThigh ");
    EXPECT_EQ(m_kTool.Map().FrameRate(), 60);
}

TEST_F(ToolTest, ALineThatSpeaksOfPositionIsAHeadAndSetsNothingUnlessItBeginsSo)
{
    LoadSource();
    LoadMap("Composition 7,8,9|");
    Add("hip", "LowerTorso");
    EXPECT_EQ(Lines(), "Composition 7,8,9|hip <---> LowerTorso .|");
    EXPECT_EQ(m_kTool.Map().RootPosition(), kVec3Zero);
}

TEST_F(ToolTest, LoadedLinesStandAsTheyWereButForUnknownBones)
{
    LoadSource();
    Add("rFoot", "RFoot");
    LoadMap("Walk|FrameRate 24|POSITION 1 -2 3.5||x <---> LThigh .|hip <---> LowerTorso .|* Head|lThigh "
            "<---> y .|");
    EXPECT_EQ(Lines(), "Walk|FrameRate 24|POSITION 1 -2 3.5||hip <---> LowerTorso .|* Head|");
    EXPECT_EQ(m_kTool.Map().RootPosition(), (Vec3{1, -2, 3.5f}));
    EXPECT_EQ(m_kTool.Map().FrameRate(), 24);
    EXPECT_EQ(Marked(), " hip > LowerTorso ") << "markers of the lines before are gone";
    EXPECT_EQ(m_kTool.Status(), "map.txt: 6 lines; 2 mappings without a bone here left out");
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Map Files |*.prf;|Nap Files |*.txt;||");

    LoadMap("hip <---> LowerTorso .|Position 4,5,6|");
    EXPECT_EQ(Lines(), std::string(kHead) + "hip <---> LowerTorso .|Position 4,5,6|");
    EXPECT_EQ(m_kTool.Map().RootPosition(), (Vec3{4, 5, 6})) << "behind the head that was put before";

    Click(kToolLoadMap, "none.txt");
    EXPECT_EQ(m_kTool.Map().Lines().size(), 5u);
    EXPECT_EQ(m_kTool.Status().find("none.txt: "), 0u);
}

TEST_F(ToolTest, AProfileIsAMapToo)
{
    LoadSource();
    Click(kToolLoadMap, "data/PoserBVH.prf");
    EXPECT_EQ(m_kTool.Map().Lines().size(), 10u);
    EXPECT_EQ(Marked(), " hip  lThigh  lShin  lFoot  rThigh  rShin  rFoot > LowerTorso  LThigh  LCalf  LFoot "
                        " RThigh  RCalf  RFoot ");
}

TEST_F(ToolTest, AMapComesBackAsItWasSaved)
{
    LoadSource();
    LoadMap(kMap);
    Click(kToolSaveMap, "saved.txt");
    EXPECT_EQ(m_kToolWindow.m_kAsked.defaultExtension, "txt");
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Map Files |*.txt;||");
    EXPECT_EQ(Read("saved.txt"), Read("map.txt"));
    Click(kToolSaveMap, "none/saved.txt");
    EXPECT_EQ(m_kTool.Status().find("Not saved: saved.txt: "), 0u) << m_kTool.Status();
}

TEST_F(ToolTest, DeletingKeepsTheSelectionOnTheLinesThatFollow)
{
    LoadSource();
    LoadMap(kMap);
    Click(kToolDelete);
    EXPECT_EQ(m_kTool.Map().Lines().size(), 9u) << "nothing is selected";
    m_kTool.SelectLine(3);
    Click(kToolDelete);
    EXPECT_EQ(m_kTool.Map().SelectedLine()->text, "lThigh <---> LThigh 10,20,30");
    EXPECT_EQ(Marked().find("hip"), std::string::npos);
    m_kTool.SelectLine(7);
    Click(kToolDelete);
    EXPECT_EQ(m_kTool.Map().Selected(), 6) << "the last one";
    Click(kToolDeleteAll);
    EXPECT_EQ(Lines(), "");
    EXPECT_EQ(Marked(), ">");
}

TEST_F(ToolTest, ASelectedMappingSelectsItsBones)
{
    LoadSource();
    LoadMap(kMap);
    m_kTool.SelectLine(4);
    EXPECT_EQ(m_kTool.SourceTree().SelectedText() + '>' + m_kTool.TargetTree().SelectedText(),
              "lThigh>LThigh");
    for (const int line : {0, 1, 5, -1, 99})
    {
        m_kTool.SelectLine(line);
        EXPECT_EQ(m_kTool.SourceTree().SelectedText(), "lThigh") << "line " << line << " names no pair";
    }
    EXPECT_FALSE(m_kTool.IsEnabled(kToolDetail));
}

TEST_F(ToolTest, DetailWritesTheLineAnewFromItsKind)
{
    const auto setNumbers = [](CMapLine& line) { line.numbers = {1.9f, -2.9f, 720.0f}; };
    const auto setRate = [](CMapLine& line) { line.frameRate = 25; };
    const auto setText = [](CMapLine& line) { line.text = "\u00c4 name of more than thirty-two characters"; };
    const struct
    {
        const char* what;
        int line;
        std::function<void(CMapLine&)> edit;
        const char* text;
    } rows[] = {
        {"a text, cut",      0, setText,    "\u00c4 name of more than thirty-two c"},
        {"the position",     1, setNumbers, "Position 1,-2,720"                    },
        {"the frame rate",   2, setRate,    "FrameRate 25"                         },
        {"a new mapping",    3, setNumbers, "hip <---> LowerTorso 1,-2,720"        },
        {"a turned mapping", 4, setNumbers, "lThigh <---> LThigh 1,-2,720"         },
    };
    LoadSource();
    LoadMap(kMap);
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        m_kTool.SelectLine(row.line);
        m_kToolWindow.m_kOnEdit = nullptr;
        const std::string before = m_kTool.Map().SelectedLine()->text;
        Click(kToolDetail);
        EXPECT_EQ(m_kTool.Map().SelectedLine()->text, before) << "cancelled";
        m_kToolWindow.m_kOnEdit = row.edit;
        Click(kToolDetail);
        EXPECT_EQ(m_kTool.Map().Lines()[static_cast<size_t>(row.line)].text, row.text);
        EXPECT_EQ(m_kTool.Map().Selected(), row.line);
    }
    EXPECT_EQ(m_kTool.Map().RootPosition(), (Vec3{1, -2, 720}));
    EXPECT_EQ(m_kTool.Map().FrameRate(), 25);
}

TEST_F(ToolTest, OtherSkeletonsTakeTheLinesOutThatSayNothingOfThem)
{
    LoadSource();
    LoadMap(kMap);
    m_kTool.SelectLine(6);
    LoadSource();
    EXPECT_EQ(Lines(), "hip <---> LowerTorso .|lThigh <---> LThigh 10,20,30|rThigh <---> RThigh .|"
                       "lFoot <---> LFoot .|rFoot <---> RFoot .|");
    EXPECT_EQ(m_kTool.Map().SelectedLine()->text, "rThigh <---> RThigh .");
    EXPECT_EQ(m_kTool.SourceTree().SelectedText(), "rThigh") << "trees keep their selection";
    EXPECT_NE(Marked().find("hip"), std::string::npos);
    EXPECT_EQ(m_kTool.Status(), "walk.bvh: 3 frames; 4 map lines without bones here removed");

    Write("max.bvh", BvhText(kMaxBones));
    Click(kToolLoadTarget, "max.bvh");
    EXPECT_EQ(Lines(), "");
    Add("hip", "Bip01");
    Click(kToolLoadSource, "max.bvh");
    EXPECT_EQ(m_kTool.TargetTree().Items().front().m_kText, "LowerTorso") << "the fixed skeleton again";
    EXPECT_EQ(Lines(), "");
}

TEST_F(ToolTest, AConversionMovesTheResultAsTheLinesSay)
{
    LoadSource(4);
    LoadMap(kMap);
    for (const int play : {1019, 1024, 1029})
        Click(play);
    EXPECT_TRUE(m_kTool.IsPlaying());
    Click(kToolConvert);
    EXPECT_FALSE(m_kTool.IsPlaying()) << "all views stand";
    EXPECT_TRUE(m_kTool.IsConverted());
    EXPECT_EQ(m_kTool.Status().find("Converted 4 frames"), 0u) << m_kTool.Status();
    EXPECT_EQ(m_kTool.LastFrameOf(EToolMotion::Result), 3);
    EXPECT_EQ(m_kToolWindow.View(EToolMotion::Result).m_spkShown,
              m_kTool.Motion(EToolMotion::Result).motionRoot);
    EXPECT_NE(ResultAt("LThigh", 0), ResultAt("LThigh", 3));
    const Vec3 path = ResultAt("LowerTorso", 3).Translation() - ResultAt("LowerTorso", 0).Translation();
    EXPECT_GT(path.z, 0.0f) << "the source walks along Z";
}

TEST_F(ToolTest, AConversionAddsThePositionToWhereTheSkeletonStands)
{
    LoadSource(4);
    const std::string rows = "|hip <---> LowerTorso .|";
    LoadMap("Walk|Position 0,0,0" + rows);
    Click(kToolConvert);
    const Vec3 origin = ResultAt("LowerTorso", 0).Translation();
    LoadMap("Walk|Position 1,2,3" + rows);
    Click(kToolConvert);
    EXPECT_LT(Vec3Length(ResultAt("LowerTorso", 0).Translation() - origin - Vec3{1, 2, 3}), 1e-3);
    EXPECT_GT(Vec3Length(origin), 1.0);
}

// The page on map lines holds a map, and a table of what changes of its text do to a conversion.
TEST_F(ToolTest, LinesDoWhatTheirPageSays)
{
    const std::string page = ReadBytes(GAITWRIGHT_DOCS "/formats/map-lines.md");
    const size_t begin = page.find("file=tiny.txt\n") + 14;
    const std::string map = page.substr(begin, page.find("```", begin) - begin);
    const auto posesOf = [this](const std::string& text) {
        LoadMap(text);
        Click(kToolConvert);
        return ResultPoses();
    };
    LoadSource(2);
    const std::vector<Mat4> plain = posesOf(map);
    const std::regex row("\\n\\| `([^`]+)` \\| `([^`]+)` \\| (differs|is the same) \\|(?=\\n)");
    int rowCount = 0;
    for (std::sregex_iterator it(page.begin(), page.end(), row), end; it != end; ++it, ++rowCount)
    {
        SCOPED_TRACE(it->str());
        const std::string from = it->str(1);
        ASSERT_NE(map.find(from), map.npos);
        EXPECT_EQ(posesOf(std::string(map).replace(map.find(from), from.size(), it->str(2))) != plain,
                  it->str(3) == "differs");
    }
    EXPECT_GE(rowCount, 9);
}

TEST_F(ToolTest, BonesThatAreNotThereHaveNoEffect)
{
    LoadSource(2);
    LoadMap("Position 0,0,0|hip <---> LowerTorso .|");
    Click(kToolConvert);
    const std::vector<Mat4> plain = ResultPoses();
    LoadMap("Position 0,0,0|hip <---> LowerTorso .|a|b|c|* nowhere|*|");
    int line = 2;
    for (const char* text : {"a <---> LThigh 1,2,3", "hip <---> b 1,2,3", "<---> "})
    {
        m_kTool.SelectLine(line++);
        m_kToolWindow.m_kOnEdit = [&](CMapLine& edited) { edited.text = text; };
        Click(kToolDetail);
    }
    EXPECT_EQ(Lines(), "Position 0,0,0|hip <---> LowerTorso .|a <---> LThigh 1,2,3|hip <---> b 1,2,3|<---> |"
                       "* nowhere|*|");
    Click(kToolConvert);
    EXPECT_EQ(ResultPoses(), plain);
}

// What a conversion leaves on the result must not show in the next one.
TEST_F(ToolTest, AConversionDoesNotDependOnTheOneBefore)
{
    LoadSource(4);
    LoadMap("hip <---> LowerTorso .|lFoot <---> LFoot .|");
    Click(kToolConvert);
    const std::vector<Mat4> once = ResultPoses();
    LoadMap(kMap);
    Click(kToolConvert);
    EXPECT_NE(ResultPoses(), once);
    LoadMap("hip <---> LowerTorso .|lFoot <---> LFoot .|");
    Click(kToolConvert);
    EXPECT_EQ(ResultPoses(), once);

    Write("max.bvh", BvhText(kMaxBones));
    Click(kToolLoadTarget, "max.bvh");
    Add("hip", "Bip01");
    Click(kToolConvert);
    const std::vector<Mat4> kept = ResultPoses();
    std::filesystem::remove(m_kFolder.Path("max.bvh"));
    Click(kToolConvert);
    EXPECT_EQ(m_kTool.Status().find("max.bvh: "), 0u) << m_kTool.Status();
    EXPECT_EQ(ResultPoses(), kept);
}

TEST_F(ToolTest, TransportButtonsMoveTheirOwnViewOnly)
{
    LoadSource(4);
    Click(kToolLoadTarget, "walk.bvh");
    // Start, back, stop, play, forward of each view.
    const struct
    {
        EToolMotion motion;
        int buttons[5];
    } rows[] = {
        {EToolMotion::Source, {1010, 1017, 1018, 1019, 1020}},
        {EToolMotion::Target, {1021, 1022, 1023, 1024, 1025}},
        {EToolMotion::Result, {1026, 1027, 1028, 1029, 1030}},
    };
    for (const auto& [motion, buttons] : rows)
    {
        SCOPED_TRACE(buttons[0]);
        const auto& [start, back, stop, play, forward] = buttons;
        const auto clickAndRead = [&, motion = motion](int id) {
            Click(id);
            return m_kTool.FrameOf(motion);
        };
        EXPECT_EQ(clickAndRead(forward), 1);
        EXPECT_EQ(clickAndRead(forward), 2);
        EXPECT_EQ(clickAndRead(back), 1);
        clickAndRead(play);
        EXPECT_TRUE(m_kTool.Advance());
        EXPECT_EQ(m_kTool.FrameOf(motion), 2);
        EXPECT_EQ(clickAndRead(stop), 2);
        EXPECT_FALSE(m_kTool.Advance());
        EXPECT_EQ(clickAndRead(start), 0);
        clickAndRead(play);
        while (m_kTool.Advance())
            ;
        EXPECT_EQ(m_kTool.FrameOf(motion), 0) << "played once";
    }
}

TEST_F(ToolTest, TheResultIsSavedAtItsFixedScale)
{
    LoadSource(120);
    LoadMap(kMap);
    Click(kToolConvert);
    Click(kToolSaveResult, "out.htr");
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Anm Files (*.htr;*.bvh) |*.htr;*.bvh||");
    EXPECT_EQ(m_kTool.Status(), "Saved out.htr, every sixtieth frame");
    EXPECT_NE(Read("out.htr").find("NumFrames 2\n"), std::string::npos) << "one frame of sixty";

    const struct
    {
        const char* target;
        const char* path;
        const char* says;
    } refused[] = {
        {"data/base.htr", "out.bvh",      "Not saved: out.bvh: results are written as .htr only"},
        {"data/base.htr", "none/out.htr", "Not saved: out.htr: the file cannot be written"      },
        {"walk.bvh",      "new.htr",      "Not saved: new.htr: the target has no rest pose"     },
    };
    for (const auto& row : refused)
    {
        Click(kToolLoadTarget, row.target);
        Click(kToolSaveResult, row.path);
        EXPECT_EQ(m_kTool.Status().find(row.says), 0u) << m_kTool.Status();
        EXPECT_FALSE(Exists(row.path));
    }
}

TEST_F(ToolTest, AMissingFixedSkeletonIsSaid)
{
    DeleteFile(m_kFolder.Path("data/base.htr"));
    LoadSource();
    EXPECT_EQ(m_kTool.Status().find("base.htr: "), 0u) << m_kTool.Status();
    EXPECT_FALSE(m_kTool.IsEnabled(kToolLoadMap));
    EXPECT_FALSE(m_kTool.IsEnabled(kToolSaveResult));
    Click(kToolLoadTarget, "walk.bvh");
    EXPECT_TRUE(m_kTool.IsEnabled(kToolLoadMap));
}

// Whatever a file holds, it is lines, and a conversion runs through them.
TEST_F(ToolTest, HostileMaps)
{
    std::string everyByte;
    for (int byte = 0; byte < 256; ++byte)
        everyByte += static_cast<char>(byte);
    const struct
    {
        const char* what;
        std::string bytes;
    } rows[] = {
        {"nothing",                                      ""                                           },
        {"empty lines",                                  std::string(1000,                              '\n')},
        {"one long line",                                              std::string(200'000,                                                                             'x')},
        {"a long mapping",                                          "hip <---> LowerTorso " + std::string(200'000,           '9')},
        {"long names",std::string(70'000,'a') + " <---> " + std::string(70'000, 'b')},
        {"every byte",                                   everyByte + everyByte                                                                                                      },
        {"zeros",                                          std::string(5000,                                                                                       '\0')},
        {"no numbers","Position a,b,c\nFrameRate\nhip <---> LowerTorso x,y,z\n"},
        {"numbers too large","Position 1e99,-1e99,nan\nFrameRate 99999999999\nhip <---> LowerTorso 1e39\n"},
        {"keywords alone",                                   "Position\n<--->\n*\nFrameRate\n"                                },
    };
    LoadSource();
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        Write("hostile.txt", row.bytes);
        Click(kToolLoadMap, "hostile.txt");
        m_kToolWindow.m_kOnEdit = [](CMapLine&) {};
        for (int line = 0; line < 5; ++line)
        {
            m_kTool.SelectLine(line);
            Click(kToolDetail);
        }
        Click(kToolConvert);
        Click(kToolSaveMap, "copy.txt");
        Click(kToolLoadMap, "copy.txt");
    }
    const std::string lines = Lines();
    Write("hostile.txt", std::string(300'000, 'x'));
    Click(kToolLoadMap, "hostile.txt");
    EXPECT_EQ(m_kTool.Status(), "hostile.txt: this cannot be opened, or is longer than any map");
    EXPECT_EQ(Lines(), lines);
}

} // namespace gw
