#include "CCamera.h"
#include "CCustomData.h"
#include "CHTMLDump.h"
#include "CLight.h"
#include "COrnHTMLPage.h"
#include "HTMLMarkup.h"
#include "HTMLText.h"
#include "Paths.h"
#include "SceneSamples.h"
#include "TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cfloat>
#include <filesystem>
#include <limits>
#include <set>
#include <tuple>

namespace gw {
namespace {

using testing::HasSubstr;

class HTMLDump : public testing::Test
{
protected:
    std::string Page(const std::string& name) const { return ReadText(m_kFolder.Path(name)); }
    std::string PageOf(const CObject& object) const { return Page(GetHTMLFileName(object, EHTMLPath::Bare)); }
    size_t FileCount() const
    {
        const std::filesystem::directory_iterator files(m_kFolder.Path());
        return static_cast<size_t>(std::distance(begin(files), end(files)));
    }

    CTempFolder m_kFolder;
};

Ref<CNode> Node(const char* name)
{
    Ref<CNode> node = new CNode;
    node->SetName(name);
    return node;
}

std::string ID(const CObject& object)
{
    return std::to_string(object.GetID());
}

// The script of a tree: a node and each place below one, in order. A node is named at the first.
std::string TreeScript(const CNode& top, const std::vector<std::pair<const CNode*, const CNode*>>& below)
{
    const auto folder = [](const CNode& node) {
        return "gFld(\"" + std::string(node.NameView()) + "\", \"OrnHTML" + ID(node) +
               ".htm target=mainFrame\")";
    };
    std::set<const CNode*> named{&top};
    std::string text = "<!--\nNode" + ID(top) + " = " + folder(top) + ";\n";
    for (const auto& [parent, node] : below)
        text += (named.insert(node).second ? "Node" + ID(*node) + " = " : "") + "insFld(Node" + ID(*parent) +
                ", " + folder(*node) + ");\n";
    return text + "initializeDocument(Node" + ID(top) + ")\n-->";
}

// A class's table as it stands on a page.
std::string Table(const char* className, const std::vector<std::pair<std::string, std::string>>& rows)
{
    std::string text = std::string("<H1>") + className +
                       "</H1>\n<HR>\n<TABLE BORDER=\"3\"><CAPTION>\xA6\xA8\xAD\xFB\xB8\xEA\xAE\xC6\n";
    for (const auto& [name, value] : rows)
        text.append("<TR><TH>").append(name).append("</TH><TD>").append(value).append("</TD></TR>\n");
    return text + "</CAPTION></TABLE>\n";
}

constexpr char kIdentity[] = "[(1.000, 0.000, 0.000, 0.000),(0.000, 1.000, 0.000, 0.000),"
                             "(0.000, 0.000, 1.000, 0.000),(0.000, 0.000, 0.000, 1.000)]";

} // namespace

TEST_F(HTMLDump, FramesTreeAndPagesAreWrittenAsTold)
{
    const Ref<CNode> root = Node(nullptr);
    const Ref<CNode> hips = new CBillboardNode;
    hips->SetName("Hips");
    root->AttachChild(hips.Get());
    root->AttachChild(new CCamera);
    hips->AttachChild(Node("Chest").Get());
    const CNode& chest = static_cast<CNode&>(*hips->ChildAt(0));
    root->WriteHTMLFrames(m_kFolder.Path());

    EXPECT_EQ(Page("Index.htm"),
              "<html>\n<head>\n<title>TKOrrin TreeView</title>\n"
              "<meta http-equiv=\"Content-Type\" content=\"text/html; charset=big5\">\n</head>\n"
              "<frameset cols=\"300,*\" frameborder=\"YES\" border=\"1\" framespacing=\"0\" rows=\"*\">\n"
              "<frame name=\"leftFrame\" scrolling=\"auto\" src=\"TreeView.htm\">\n"
              "<frame name=\"mainFrame\" src=\"OrnHTML" +
                  ID(*root) +
                  ".htm\">\n"
                  "</frameset>\n<noframes>\n<body bgcolor=\"#FFFFFF\">\n</body>\n</noframes>\n</html>\n");
    EXPECT_EQ(Page("TreeView.htm"),
              "<html>\n<head>\n<title>\xA4\xBA\xAE\x65</title>\n"
              "<meta http-equiv=\"Content-Type\" content=\"text/html; charset=big5\">\n"
              "<script language=\"JavaScript\" src=\"TreeView.js\">\n</script>\n</head>\n"
              "<body bgcolor=\"#FFFFFF\">\n<script language=\"JavaScript\">\n" +
                  TreeScript(*root, {{root.Get(), hips.Get()}, {hips.Get(), &chest}}) +
                  "\n</script>\n</body>\n</html>\n");
    EXPECT_EQ(FileCount(), 6u) << "two frames, four objects";

    root->WriteHTMLFrames(m_kFolder.Path());
    EXPECT_EQ(FileCount(), 6u) << "a second dump replaces the first";
}

TEST_F(HTMLDump, APageHasTheTablesOfAllClassesOfItsObject)
{
    const Ref<CNode> root = TrackedNode({0, 1});
    root->SetName(nullptr);
    root->m_bForceCull = true;
    root->m_kMatrix.SetTranslation({0.0005f, -1234.5678f, 7});
    const Ref<CPointLight> light = new CPointLight;
    light->SetName("Lamp");
    light->m_kLocation = {1, 2, 3};
    light->m_fIntensity = FLT_MAX;
    root->AttachChild(light.Get());
    root->WriteHTMLFrames(m_kFolder.Path());

    const auto object = [](const std::string& name, const std::string& controls, const CObject& of) {
        return "<meta http-equiv=\"Content-Type\" content=\"text/html; charset=big5\">\n" +
               Table("CObject", {{"\xAA\xAB\xA5\xF3\xA6\x57\xBA\xD9", name},
                                 {"\xB1\xB1\xA8\xEE\xAA\xAB\xA5\xF3", controls},
                                 {"\xAA\xAB\xA5\xF3ID", ID(of)}});
    };
    const auto spatial = [](const std::string& parent, const std::string& matrix, const char* cull) {
        return Table("CSpatial", {{"Parent", parent},
                                  {"m_kMatrix", matrix},
                                  {"m_kWorldMatrix", kIdentity},
                                  {"m_bForceCull", cull}});
    };
    const CObject& control = *root->GetControl();
    const std::string toControl = "<BR><A HREF=\".\\OrnHTML" + ID(control) + ".htm\">CKeyframeControl";
    EXPECT_EQ(PageOf(*root), object("NoName", toControl, *root) +
                                 spatial("NULL",
                                         "[(1.000, 0.000, 0.000, 0.000),(0.000, 1.000, 0.000, 0.000),"
                                         "(0.000, 0.000, 1.000, 0.000),(0.001, -1234.568, 7.000, 1.000)]",
                                         "true") +
                                 Table("CNode", {{"m_kChild", "<BR><A HREF=\".\\OrnHTML" + ID(*light) +
                                                                  ".htm\">CPointLight Lamp"}}));
    EXPECT_EQ(PageOf(*light),
              object("Lamp", "", *light) +
                  spatial("<A HREF=\".\\OrnHTML" + ID(*root) + ".htm\">CNode", kIdentity, "false") +
                  Table("CLight", {{"m_kRGB", "(0.000, 0.000, 0.000)"}, {"m_fIntensity", "INFINITY"}}) +
                  Table("CPointLight", {{"m_kLocation", "(1.000, 2.000, 3.000)"},
                                        {"m_kWorldLocation", "(0.000, 0.000, 0.000)"}}));
    EXPECT_EQ(PageOf(control), object("NoName", "", control)) << "a control has the table of all";
}

TEST_F(HTMLDump, CustomDataHasNoTableAndAnObjectThatIsNoNodeNoSite)
{
    const Ref<CRawData> data = new CRawData;
    data->WriteHTMLFrames(m_kFolder.Path());
    EXPECT_EQ(FileCount(), 0u);
    COrnHTMLWriter page;
    data->DumpHTML(m_kFolder.Path(), page);
    ASSERT_TRUE(page.SaveAs(m_kFolder.Path("data.htm")));
    EXPECT_EQ(Page("data.htm"), "");
}

TEST_F(HTMLDump, SharedObjectsHaveOnePageAndAnEntryAtEachPlace)
{
    const Ref<CNode> root = Node("root");
    const Ref<CNode> shared = Node("shared");
    const Ref<CNode> other = Node("other");
    for (CNode* child : {shared.Get(), other.Get(), shared.Get()})
        root->AttachChild(child);
    other->AttachChild(shared.Get());
    shared->AttachChild(root.Get()); // a cycle
    CHTMLDump dump(m_kFolder.Path());
    dump.WriteSite(*root);
    dump.WriteSite(*other);
    EXPECT_EQ(FileCount(), 7u);
    const auto [r, s, o] = std::tuple(root.Get(), shared.Get(), other.Get());
    EXPECT_THAT(Page("TreeView.htm"), HasSubstr(TreeScript(*r, {{r, s}, {r, o}, {r, s}, {s, r}, {o, s}})));
    EXPECT_THAT(Page("TreeView2.htm"), HasSubstr(TreeScript(*o, {{o, s}, {s, r}, {r, s}, {r, o}, {r, s}})));
    shared->DetachChild(root.Get());
}

TEST_F(HTMLDump, TreesOfManyRootsStayWithinALimit)
{
    constexpr size_t kWidth = 1200; // squared, more than the limit
    const Ref<CNode> shared = Node("shared");
    std::vector<Ref<CNode>> roots(kWidth);
    for (auto& root : roots)
    {
        shared->AttachChild(new CNode);
        root = Node("root");
        root->AttachChild(shared.Get());
    }
    CHTMLDump dump(m_kFolder.Path("no folder/")); // counting its pages is enough
    for (const auto& root : roots)
        dump.WriteSite(*root);
    EXPECT_EQ(dump.PageCount(), 4 * kWidth + 1);
    EXPECT_LT(dump.EntryCount(), CHTMLDump::kEntryLimit + 3 * kWidth);
}

TEST_F(HTMLDump, AFileThatCannotBeOpenedIsPassedOver)
{
    const Ref<CNode> root = Node("root");
    const Ref<CNode> child = Node("child");
    const Ref<CNode> grandchild = Node("grandchild");
    root->AttachChild(child.Get());
    child->AttachChild(grandchild.Get());
    ASSERT_TRUE(CreateFolder(m_kFolder.Path("Index.htm")));
    ASSERT_TRUE(CreateFolder(m_kFolder.Path(GetHTMLFileName(*child, EHTMLPath::Bare))));
    root->WriteHTMLFrames(m_kFolder.Path());
    EXPECT_THAT(PageOf(*grandchild), HasSubstr("grandchild"));
    EXPECT_THAT(PageOf(*root), HasSubstr("root"));

    COrnHTMLPage page;
    WriteBytes(m_kFolder.Path("elsewhere"), "kept");
    const bool hasLink = MakeLink("elsewhere", m_kFolder.Path("link.htm"));
    EXPECT_FALSE(page.SaveAs(m_kFolder.Path("Index.htm")));
    EXPECT_EQ(page.SaveAs(m_kFolder.Path("link.htm")), !hasLink);
    EXPECT_EQ(Page("elsewhere"), "kept");
    EXPECT_TRUE(page.SaveAsText(m_kFolder.Path("page.htm").c_str()));
    root->WriteHTMLFrames(m_kFolder.Path("no folder/"));
    EXPECT_FALSE(FolderExists(m_kFolder.Path("no folder")));
}

TEST_F(HTMLDump, APageIsFollowedByThePagesInIt)
{
    COrnHTMLPage inner;
    inner.AddFormat("%s-%u", std::string(5000, 'x').c_str(), 7u);
    COrnHTMLWriter page;
    page.AddLine("100% first");
    page.AddPage(inner);
    page.AddLine("second");
    ASSERT_TRUE(page.SaveAs(m_kFolder.Path("page.htm")));
    EXPECT_EQ(Page("page.htm"), "100% first\nsecond\n" + std::string(5000, 'x') + "-7\n");
}

TEST(HTMLText, NamesAreNoMarkupAndNoScript)
{
    const std::tuple<const char*, std::string_view, std::string_view, std::string_view> rows[] = {
        {"plain", "Left Foot_1", "Left Foot_1", "Left Foot_1"},
        {"markup", "<b>&\"'", "&lt;b&gt;&amp;&quot;'", "\\x3cb>&\\x22'"},
        {"end of a text", "a\\\"b\r\n", "a\\&quot;b\r\n", "a\\x5c\\x22b\\x0d\\x0a"},
        {"control bytes", "\x1b\x7f", "\x1b&#127;", "\\x1b\\x7f"},
        {"two, three and four bytes of UTF-8", "\u00fc\u6771\U0001f9b4", "&#252;&#26481;&#129460;",
         "\\xfc\\u{6771}\\u{1f9b4}"},
        {"Big5 whose second byte is a backslash", "\xa5\x5c\"", "\xa5\x5c&quot;", "\\u{529f}\\x22"},
        {"what only looks so", "\x81\x5c\"", "\x81\x5c&quot;", "\\x81\\x5c\\x22"},
        {"half a character", "\xa5<", "\xa5&lt;", "\\xa5\\x3c"},
        {"UTF-8 that is longer than it must be", "\xc0\xbc", "\xc0\xbc", "\\u{64d8}"},
        {"half of a pair", "\xed\xa0\x80", "\xed\xa0\x80", "\\xed\\xa0\\x80"},
        {"beyond the last character", "\xf4\x90\x80\x80", "\xf4\x90\x80\x80", "\\xf4\\x90\\x80\\x80"},
        {"UTF-8 cut short", "\u6771\xe6\x9d", "\u6771\xe6\x9d", "\\xe6\\x9d\\xb1\\xe6\\x9d"},
    };
    for (const auto& [what, name, page, script] : rows)
    {
        SCOPED_TRACE(what);
        EXPECT_EQ(HTMLText(name), page);
        EXPECT_EQ(HTMLScriptText(name), script);
    }
}

TEST(HTMLText, FloatsWithoutEndAreWords)
{
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    const float below = std::nextafter(FLT_MAX, 0.0f);
    const std::tuple<float, std::string_view> rows[] = {
        {0.0f, "0.000"},
        {-1.0005f, "-1.000"},
        {FLT_MAX, "INFINITY"},
        {kInfinity, "INFINITY"},
        {below, "340282326356119256160033759537265639424.000"},
    };
    for (const auto& [value, text] : rows)
        EXPECT_EQ(HTMLText(value), text);
    EXPECT_EQ(HTMLText(Vec3{kInfinity, 1, -0.0f}), "(inf, 1.000, -0.000)");
}

TEST(HTMLMarkup, AnchorsGetTheirFolderAndEndingWhereTheyHaveNone)
{
    EXPECT_EQ(HTMLAnchor("a", "text"), "<A HREF=\".\\a.htm\">text");
    EXPECT_EQ(HTMLAnchor("a.html", "text"), "<A HREF=\".\\a.html\">text");
    EXPECT_EQ(HTMLAnchor("b\\a", "text"), "<A HREF=\"b\\a.htm\">text");
    EXPECT_EQ(HTMLTable(EHTMLEnd::Opening, 12), "<TABLE BORDER=\"12\"><CAPTION>");
}

} // namespace gw
