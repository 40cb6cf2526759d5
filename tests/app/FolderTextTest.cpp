// Text entered in file dialogs: the path of the folder chooser, and filters.

#include "ContentFixture.h"

#include "FileFilter.h"
#include "FolderText.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {
namespace {

TEST(FolderText, NamesAFolderByBothSeparators)
{
    // place: null for none
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"nothing is the open folder", "", "/home/ann/"},
        {"the open folder itself", "/home/ann", "/home/ann/"},
        {"a separator at the end goes and comes", "/takes/", "/takes/"},
        {"the other separator", "\\takes\\day 1\\", "/takes/day 1/"},
        {"the root", "/", "/"},
        {"a name in the open folder", "takes/day 1", "/home/ann/takes/day 1/"},
        {"a drive of another system", "C:\\takes", "C:/takes/"},
        {"two backslashes in a row", "/takes\\\\day", nullptr},
        {"two backslashes at the end", "/takes\\\\", nullptr},
        {"two slashes in a row", "//takes", nullptr},
        {"one of each", "/takes/\\day", nullptr},
        {"only the two", "\\\\", nullptr},
    };
    for (const auto& [what, text, place] : rows)
    {
        SCOPED_TRACE(what);
        const std::optional<std::string> folder = FolderOfText(text, "/home/ann");
        EXPECT_EQ(WithSlashes(folder.value_or("none")), place ? place : "none");
    }
    EXPECT_EQ(WithSlashes(FolderOfText("takes", "/").value_or("none")), "/takes/");
}

std::vector<std::string> Told(std::string_view filter)
{
    std::vector<std::string> told;
    for (const FileFilter& choice : SplitFilter(filter))
    {
        told.push_back(choice.text);
        told.insert(told.end(), choice.patterns.begin(), choice.patterns.end());
    }
    return told;
}

TEST(FileFilter, IsCutIntoTextsAndPatterns)
{
    using testing::ElementsAre;
    EXPECT_THAT(Told("BVH (*.bvh) |*.bvh|ORN|*.orn||"), ElementsAre("BVH (*.bvh) ", "*.bvh", "ORN", "*.orn"));
    EXPECT_THAT(Told("Motions|*.bvh;*.htr|"), ElementsAre("Motions", "*.bvh", "*.htr"));
    EXPECT_THAT(Told("Motions|*.bvh"), ElementsAre("Motions", "*.bvh"));
    EXPECT_THAT(Told("Motions|"), ElementsAre());
    EXPECT_THAT(Told("||"), ElementsAre());
    EXPECT_THAT(Told(""), ElementsAre());
}

} // namespace
} // namespace gw
