#include "CSkin.h"
#include "Paths.h"
#include "TempFolder.h"

#include <gmock/gmock.h>

namespace gw {

TEST(Skin, SaysWhatIsMissingOrWrong)
{
    const std::string whole = ExecutableFolder() + "Content/";
    const std::string layout = ReadBytes(whole + "bvh.cnt");
    std::string withoutBar = layout;
    withoutBar.erase(withoutBar.find("bar "),
                     withoutBar.find('\n', withoutBar.find("bar ")) - withoutBar.find("bar "));
    const struct
    {
        const char* file;
        std::string text;
        const char* words;
    } rows[] = {
        {"bvh.cnt", "",                                 "has no size"          },
        {"bvh.cnt", withoutBar,                         "no child \"|playbar\""},
        {"bvh.cnt", layout + "button x 1 2 three 4\n",  "invalid line"         },
        {"bvh.cnt", layout + "button x 1 2 0 4\n",      "invalid line"         },
        {"bvh.cnt", layout + "knob x 1 2 3 4\n",        "invalid line"         },
        {"bvh.cnt", layout + "button x 1 2 3 4 none\n", "icons/none.svg"       },
        {"bvh.cnt", "size 1 99999\n" + layout,          "invalid line"         },
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.words);
        const CTempFolder folder;
        for (const char* name : {"bvh.cnt", "bvh.ini", "bvh.qss"})
            WriteBytes(folder.Path(name), ReadBytes(whole + name));
        CreateFolder(folder.Path("icons"));
        for (const std::string& icon : FilesInFolder(whole + "icons/", ".svg"))
            WriteBytes(folder.Path("icons/" + icon), ReadBytes(whole + "icons/" + icon));
        CSkin skin;
        std::string problem;
        EXPECT_TRUE(skin.Load(folder.Path(), problem)) << problem;
        WriteBytes(folder.Path(row.file), row.text);
        EXPECT_FALSE(skin.Load(folder.Path(), problem));
        EXPECT_THAT(problem, testing::HasSubstr(row.words));
    }
    CSkin skin;
    std::string problem;
    EXPECT_FALSE(skin.Load("/nowhere", problem));
    EXPECT_THAT(problem, testing::HasSubstr("/nowhere/bvh.cnt"));
}

} // namespace gw
