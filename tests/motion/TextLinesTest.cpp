#include "CTextLines.h"
#include "TempFolder.h"

#include <gmock/gmock.h>
#include <string>
#include <tuple>
#include <vector>

namespace gw {
namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;

// A file that is open as lines.
class COpenText
{
public:
    explicit COpenText(std::string_view text)
    {
        WriteBytes(m_kFolder.Path("text"), text);
        EXPECT_EQ(lines.Open(m_kFolder.Path("text")), EFailure::None);
    }
    // All pieces with the numbers of their lines; long ones as their length.
    std::vector<std::string> All()
    {
        std::vector<std::string> all;
        for (std::string_view line; lines.Next(line);)
        {
            const std::string text = line.size() > 20 ? std::to_string(line.size()) : std::string(line);
            all.push_back(std::to_string(lines.LineNumber()) + ":" + text);
        }
        return all;
    }

    CTextLines lines;

private:
    CTempFolder m_kFolder;
};

TEST(CTextLines, EndsLinesAndCutsLongOnes)
{
    const std::string full(CTextLines::kPieceLength, 'x');
    const std::string shorter(CTextLines::kPieceLength - 1, 'x');
    const std::tuple<const char*, std::string, std::vector<std::string>> rows[] = {
        {"carriage returns and line feeds, mixed", "a\r\n\r\nb\nc\r\n", {"1:a", "2:", "3:b", "4:c"}},
        {"no end behind the last line", "a\nb", {"1:a", "2:b"}},
        {"a lone carriage return is a character", "a\rb\n\r", {"1:a\rb", "2:\r"}},
        {"a byte order mark",
         "\xef\xbb\xbf"
         "a\n",
         {"1:a"}},
        {"just shorter than a piece", shorter + "\nb", {"1:4094", "2:b"}},
        {"a full piece leaves its line end", full + "\nb", {"1:4095", "1:", "2:b"}},
        {"a full piece leaves both its line ends", full + "\r\nb", {"1:4095", "1:", "2:b"}},
        {"a full piece ends the text", full, {"1:4095"}},
        {"carriage return at the cut", full + "\ry\nb", {"1:4095", "1:\ry", "2:b"}},
        {"three pieces", full + full + "y\r\nb", {"1:4095", "1:4095", "1:y", "2:b"}},
    };
    for (const auto& [what, words, pieces] : rows)
        EXPECT_THAT(COpenText(words).All(), ElementsAreArray(pieces)) << what;
}

TEST(CTextLines, StepsBackOverOneReadAndTakesRowsWhole)
{
    const std::string full(CTextLines::kPieceLength, 'x');
    COpenText text("a\n" + full + "yz\r\nb\n");
    std::string_view line;
    ASSERT_TRUE(text.lines.Next(line));
    text.lines.StepBack();
    EXPECT_EQ(text.lines.LineNumber(), 0u);
    EXPECT_TRUE(text.lines.Next(line) && line == "a");

    ASSERT_TRUE(text.lines.NextRow(line));
    EXPECT_EQ(line, full + "yz");
    text.lines.StepBack();
    ASSERT_TRUE(text.lines.Next(line));
    ASSERT_TRUE(text.lines.NextRow(line)) << "the rest of a line that was begun";
    EXPECT_EQ(line, "yz");
    EXPECT_EQ(text.lines.LineNumber(), 2u);
    EXPECT_THAT(text.All(), ElementsAre("3:b"));
    EXPECT_EQ(text.lines.BytesLeft(), 0u);
}

} // namespace
} // namespace gw
