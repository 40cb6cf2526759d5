#include "CSkin.h"
#include "Paths.h"
#include "TempFolder.h"

#include <filesystem>
#include <gmock/gmock.h>
#include <tuple>

namespace gw {

TEST(Skin, SaysWhatIsMissingOrWrong)
{
    const std::string whole = ExecutableFolder() + "Content/";
    const std::string layout = ReadBytes(whole + "bvh.cnt");
    std::string withoutBar = layout;
    withoutBar.erase(withoutBar.find("bar "),
                     withoutBar.find('\n', withoutBar.find("bar ")) - withoutBar.find("bar "));
    const std::tuple<const char*, std::string, const char*> rows[] = {
        {"bvh.cnt", "", "has no size"},
        {"bvh.cnt", withoutBar, "no child \"|playbar\""},
        {"bvh.cnt", layout + "button x 1 2 three 4\n", "invalid line"},
        {"bvh.cnt", layout + "button x 1 2 0 4\n", "invalid line"},
        {"bvh.cnt", layout + "knob x 1 2 3 4\n", "invalid line"},
        {"bvh.cnt", layout + "button x 1 2 3 4 none\n", "icons/none.svg"},
        {"bvh.cnt", "size 1 99999\n" + layout, "invalid line"},
    };
    for (const auto& [file, text, words] : rows)
    {
        SCOPED_TRACE(words);
        const CTempFolder folder;
        std::filesystem::copy(whole, folder.Path(), std::filesystem::copy_options::recursive);
        CSkin skin;
        std::string problem;
        EXPECT_TRUE(skin.Load(folder.Path(), problem)) << problem;
        WriteBytes(folder.Path(file), text);
        EXPECT_FALSE(skin.Load(folder.Path(), problem));
        EXPECT_THAT(problem, testing::HasSubstr(words));
    }
    CSkin skin;
    std::string problem;
    EXPECT_FALSE(skin.Load("/nowhere", problem));
    EXPECT_THAT(problem, testing::HasSubstr("/nowhere/bvh.cnt"));
}

TEST(Skin, ShrinksToTheScreen)
{
    const std::tuple<QSize, QSize> rows[] = {
        {{1024, 768}, {1000, 630}}, // room enough
        {{683, 512}, {683, 430}},   // 1024 x 768 at a scale of 1.5
        {{400, 300}, {500, 315}},   // smaller would not be readable
    };
    for (const auto& [screen, size] : rows)
    {
        CSkin skin;
        std::string problem;
        ASSERT_TRUE(skin.Load(ExecutableFolder() + "Content/", problem)) << problem;
        skin.ShrinkTo(screen);
        EXPECT_EQ(skin.Size(), size);
        for (const SkinChild& child : skin.Children())
            EXPECT_TRUE(QRect(QPoint(), size).contains(child.place)) << child.name;
    }
}

} // namespace gw
