#include "ContentFixture.h"

#include "CProfileEditorDialog.h"
#include "Paths.h"

#include <tuple>

namespace gw {
namespace {

std::vector<std::string> Items(const CProfileList& list)
{
    std::vector<std::string> items;
    for (int index = 0; const std::string* text = list.GetItemText(index); ++index)
        items.push_back(*text + (list.GetItemUserData(index) == 1 ? " (stock)" : ""));
    return items;
}

} // namespace

TEST_F(ContentTest, TheListHoldsStockProfilesThenCustomOnes)
{
    Write("docs/BVH Profile/custom9.PRF", "Another  \nFrameRate 30\n");
    Write("docs/BVH Profile/notes.txt", "no profile\n");
    m_kContent.RefreshProfileList();
    EXPECT_EQ(Items(m_kWindow.m_kList),
              (std::vector<std::string>{"3DS MAX (stock)", "Poser (stock)", "Mine", "Another"}));
}

TEST_F(ContentTest, PathsByDisplayName)
{
    Write("docs/BVH Profile/Custom1.prf", "poser\n"); // hidden by the stock profile with that name
    const std::tuple<const char*, const char*, std::string> rows[] = {
        {"a stock profile", "Poser", "data/PoserBVH.prf"},
        {"case does not matter", "POSER", "data/PoserBVH.prf"},
        {"a custom profile", "mine", "docs/BVH Profile/Custom0.prf"},
        {"a name that nobody has", "Nobody", ""},
    };
    for (const auto& [what, name, path] : rows)
        EXPECT_EQ(WithSlashes(m_kContent.FindProfilePath(name)),
                  path.empty() ? "" : WithSlashes(m_kFolder.Path(path)))
            << what;
}

TEST_F(ContentTest, TheCustomFolderIsTheHostsOrTheDocuments)
{
    EXPECT_EQ(WithSlashes(m_kContent.ProfileFile("")), WithSlashes(m_kFolder.Path("docs/BVH Profile/")));
    m_kPlatform.m_kHostKeys["SOFTWARE\\Tessarine\\Kestro\\2.0/Custom Data"] = m_kFolder.Path("host");
    EXPECT_EQ(WithSlashes(m_kContent.ProfileFile("a.prf")),
              WithSlashes(m_kFolder.Path("host/BVH Profile/a.prf")));
    EXPECT_TRUE(FolderExists(m_kFolder.Path("host/BVH Profile")));
}

TEST_F(ContentTest, StockChoice)
{
    const std::string none = BvhText({"a", "b", "c", "d", "e", "f", "g"});
    const struct
    {
        const char* what;
        std::string source;
        const char* before; // selected by the user before
        const char* after;
    } rows[] = {
        {"the Poser profile fits", BvhText(kPoserBones), "", "Poser"},
        {"it wins over a choice by hand", BvhText(kPoserBones), "Mine", "Poser"},
        {"the MAX profile fits", BvhText(kMaxBones), "", "3DS MAX"},
        {"it replaces the Poser profile", BvhText(kMaxBones), "Poser", "3DS MAX"},
        {"but not another choice by hand", BvhText(kMaxBones), "Mine", "Mine"},
        {"neither fits, the choice stays", none, "Mine", "Mine"},
        {"neither fits, none is chosen", none, "", ""},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        m_kWindow.m_kList.SetCurSel(-1);
        if (*row.before)
            SelectProfile(row.before);
        Open(Write("source.bvh", row.source));
        EXPECT_EQ(SelectedProfile(), row.after);
        const bool isChosen = *row.after != '\0';
        EXPECT_TRUE(!isChosen || m_kContent.ProfilePath() == m_kContent.FindProfilePath(row.after));
    }
    Write("data/PoserBVH.prf", "Poser\nFrameRate 30\n");
    SelectProfile("Mine");
    Open(Write("source.bvh", none));
    EXPECT_EQ(SelectedProfile(), "Mine") << "a profile without rows fits nothing";
}

TEST_F(ContentTest, StockNamesAreThoseOfTheLastRefresh)
{
    Write("data/PoserBVH.prf", BoneMapText("Renamed", kPoserBones));
    const std::string walk = Write("walk.bvh", BvhText(kPoserBones));
    for (const char* name : {"Poser", "Renamed"})
    {
        Open(walk);
        EXPECT_EQ(SelectedProfile(), name);
        m_kContent.RefreshProfileList();
    }
}

TEST_F(ContentTest, DeletingAProfile)
{
    SelectProfile("Mine");
    const std::string path = m_kContent.ProfilePath();
    m_kWindow.m_kAnswers[166] = EAnswer::Cancel;
    m_kContent.ChildClick("del");
    EXPECT_TRUE(FileExists(path));

    m_kWindow.m_kAnswers[166] = EAnswer::OK;
    m_kContent.ChildClick("del");
    EXPECT_FALSE(FileExists(path));
    EXPECT_EQ(SelectedProfile(), "Poser") << "the last entry that is left";
    EXPECT_EQ(m_kContent.ProfileEditor()->ProfilePath(), m_kFolder.Path("data/PoserBVH.prf"));
    EXPECT_EQ(m_kContent.ProfilePath(), path) << "still the deleted file, until the next choice";
    EXPECT_FALSE(m_kWindow.m_kEnabled["del"]);
}

TEST_F(ContentTest, PruningPassesOverWhatSlidesIntoAPlace)
{
    for (const char* name : {"gone 1", "gone 2", "gone 3"})
        m_kWindow.m_kList.AddItem(name, 0);
    Write("docs/BVH Profile/new.prf", "new\n");
    m_kWindow.m_kList.AddItem("new", 0); // not listed yet, but its file is there
    m_kContent.PruneProfileList();
    EXPECT_EQ(Items(m_kWindow.m_kList),
              (std::vector<std::string>{"3DS MAX (stock)", "Poser (stock)", "Mine", "gone 2", "new"}));
    m_kWindow.m_kList.SetCurSel(3);
    m_kContent.PruneProfileList();
    EXPECT_EQ(SelectedProfile(), "gone 2") << "the selected one stays";
}

TEST_F(ContentTest, AnUnsavedNameStandsInTheListAndCannotBeDeleted)
{
    SelectProfile("Mine");
    m_kContent.ProfileEditor()->EditField(kNameField, "Renamed");
    m_kContent.ProfileEditor()->LeaveField();
    EXPECT_EQ(SelectedProfile(), "Renamed");
    EXPECT_EQ(m_kWindow.m_kList.GetItemUserData(m_kWindow.m_kList.GetCurSel()), 0);
    EXPECT_FALSE(m_kWindow.m_kEnabled["del"]) << "it has never been read from a file";
    EXPECT_TRUE(m_kWindow.m_kEnabled["%adv"]);
}

TEST_F(ContentTest, ListsKeepASelectionWhenEntriesGo)
{
    const std::tuple<const char*, int, int, int> rows[] = {
        {"one before it", 2, 0, 1},    {"one behind it", 0, 2, 0}, {"itself", 1, 1, 1},
        {"itself, the last", 2, 2, 1}, {"all", 1, -1, -1},         {"none there", 1, 7, 1},
    };
    for (const auto& [what, selected, deleted, after] : rows)
    {
        CProfileList list;
        for (const char* name : {"a", "b", "c"})
            list.AddItem(name, 0);
        list.SetCurSel(selected);
        list.DeleteItem(deleted);
        EXPECT_EQ(list.GetCurSel(), after) << what;
    }
}

} // namespace gw
