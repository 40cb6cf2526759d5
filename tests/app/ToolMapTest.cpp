// The lines of the map tool: editing, loading and saving them, and their effect on a conversion.

#include "ToolFixture.h"

#include <regex>
#include <tuple>

namespace gw {

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

    LoadMap("* Head|x <---> LThigh .|");
    EXPECT_EQ(m_kTool.Status(), "map.txt: 1 line; 1 mapping without a bone here left out");
    m_kTool.SelectLine(0);
    Add("hip", "LowerTorso");
    EXPECT_EQ(m_kTool.Map().SelectedLine()->text, "* Head") << "the selection moves behind the head";

    LoadMap("hip <---> LowerTorso .|Position 4,5,6|");
    EXPECT_EQ(Lines(), std::string(kHead) + "hip <---> LowerTorso .|Position 4,5,6|");
    EXPECT_EQ(m_kTool.Map().RootPosition(), (Vec3{4, 5, 6})) << "behind the head that was put before";

    Click(kToolLoadMap, "none.txt");
    EXPECT_EQ(m_kTool.Map().Lines().size(), 5u);
    EXPECT_EQ(m_kTool.Status().find("none.txt: "), 0u);
}

TEST_F(ToolTest, AMapComesBackAsItWasSaved)
{
    LoadSource();
    LoadMap(kMap);
    Click(kToolSaveMap, "saved.txt");
    EXPECT_EQ(m_kToolWindow.m_kAsked.defaultExtension, "txt");
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Map Files |*.txt;||");
    EXPECT_EQ(ReadText(m_kFolder.Path("saved.txt")), Read("map.txt"));
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
    const auto setNumbers = [](MapLine& line) { line.numbers = {1.9f, -2.9f, 720.0f}; };
    const auto setRate = [](MapLine& line) { line.frameRate = 25; };
    const auto setText = [](MapLine& line) { line.text = "\u00c4 name of more than thirty-two characters"; };
    const std::tuple<const char*, int, std::function<void(MapLine&)>, const char*> rows[] = {
        {"a text, cut", 0, setText, "\u00c4 name of more than thirty-two c"},
        {"the position", 1, setNumbers, "Position 1,-2,720"},
        {"the frame rate", 2, setRate, "FrameRate 25"},
        {"a new mapping", 3, setNumbers, "hip <---> LowerTorso 1,-2,720"},
        {"a turned mapping", 4, setNumbers, "lThigh <---> LThigh 1,-2,720"},
    };
    LoadSource();
    LoadMap(kMap);
    for (const auto& [what, original, edit, text] : rows)
    {
        SCOPED_TRACE(what);
        m_kTool.SelectLine(original);
        m_kToolWindow.onEdit = nullptr;
        const std::string before = m_kTool.Map().SelectedLine()->text;
        Click(kToolDetail);
        EXPECT_EQ(m_kTool.Map().SelectedLine()->text, before) << "cancelled";
        m_kToolWindow.onEdit = edit;
        Click(kToolDetail);
        EXPECT_EQ(m_kTool.Map().Lines()[static_cast<size_t>(original)].text, text);
        EXPECT_EQ(m_kTool.Map().Selected(), original);
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

// The page on map lines contains a map, and a table of the effects of changes on a conversion.
TEST_F(ToolTest, LinesDoWhatTheirPageSays)
{
    const std::string page = ReadBytes(GAITWRIGHT_PROJECT "/docs/formats/map-lines.md");
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

// Any file can be read as lines and used in a conversion.
TEST_F(ToolTest, HostileMaps)
{
    std::string everyByte;
    for (int byte = 0; byte < 256; ++byte)
        everyByte += static_cast<char>(byte);
    const std::string hostile[] = {
        "",
        std::string(200'000, 'x'),
        "hip <---> LowerTorso " + std::string(200'000, '9'),
        everyByte + everyByte,
        "Position 1e99,-1e99,nan\nFrameRate 99999999999\nhip <---> LowerTorso 1e39\n",
    };
    LoadSource();
    m_kToolWindow.onEdit = [](MapLine&) {};
    for (const std::string& bytes : hostile)
    {
        Write("hostile.txt", bytes);
        Click(kToolLoadMap, "hostile.txt");
        m_kTool.SelectLine(2);
        for (const int button : {kToolDetail, kToolConvert})
            Click(button);
        Click(kToolSaveMap, "copy.txt");
    }
    const std::string lines = Lines();
    Write("hostile.txt", std::string(300'000, 'x'));
    Click(kToolLoadMap, "hostile.txt");
    EXPECT_EQ(m_kTool.Status(), "hostile.txt: this cannot be opened, or is longer than any map");
    EXPECT_EQ(Lines(), lines);
}

} // namespace gw
