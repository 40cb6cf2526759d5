#include "LinkNames.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <tuple>

namespace gw {

TEST(LinkNames, LeadIntoTheContainersFolderOrToAFileThatIsThere)
{
    const CTempFolder folder;
    const std::string there = folder.Path("there.png");
    WriteBytes(there, "x");
    const std::tuple<std::string, std::string> rows[] = {
        {"a.png", "C:\\scenes\\a.png"},
        {"textures\\wood/a.png", "C:\\scenes\\wood\\a.png"},
        {"x\\..\\..\\a.png", "C:\\scenes\\a.png"},
        {"C:a.png", "C:\\scenes\\a.png"}, // not a second stream of a file named "C"
        {"C:\\nowhere\\a.png", "C:\\scenes\\a.png"},
        {"/nowhere/a.png", "C:\\scenes\\a.png"},
        {"x\\caf\xe9.png", "C:\\scenes\\caf\ufffd.png"}, // not UTF-8
        {there, there},
        {folder.Path("x/../there.png"), there},
    };
    for (const auto& [name, path] : rows)
        EXPECT_EQ(ResolveLinkName("C:\\scenes", name), path) << name;
}

TEST(LinkNames, AreStoredSoThatTheyLeadBack)
{
    const std::tuple<const char*, const char*> rows[] = {
        {"C:\\scenes\\a.png", "a.png"},
        {"C:/scenes/wood/oak/a.png", ".\\wood\\oak\\a.png"},
        {"C:\\scenes\\x\\..\\a.png", "a.png"},
        {"C:\\scenes2\\a.png", "C:\\scenes2\\a.png"},
        {"D:\\scenes\\a.png", "D:\\scenes\\a.png"},
        {"/scenes/a.png", "/scenes/a.png"}, // of another system
    };
    for (const auto& [path, stored] : rows)
        EXPECT_EQ(StoredLinkName("C:\\scenes", path), stored) << path;
}

} // namespace gw
