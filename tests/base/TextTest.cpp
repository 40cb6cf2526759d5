#include "Text.h"

#include "CFailureRecord.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

// Returns all tokens, or all lines, each followed by a bar.
std::string Tokens(std::string_view text)
{
    std::string tokens;
    for (std::string_view token = NextToken(text); !token.empty(); token = NextToken(text))
        tokens.append(token).append("|");
    return tokens;
}

std::string Lines(std::string_view text)
{
    std::string lines;
    for (std::string_view line; NextLine(text, line);)
        lines.append(line).append("|");
    return lines;
}

} // namespace

TEST(Text, TokensAreCutAtRunsOfDelimiters)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"nothing", "", ""},
        {"delimiters only", " ,\t\n", ""},
        {"a comma is a blank", "1,2 3", "1|2|3|"},
        {"runs, and at both ends", ",\n a \t, bc ,", "a|bc|"},
        {"a carriage return is none", "a\rb c\r", "a\rb|c\r|"},
        {"bytes above 127 are none", "H\xc3\xbc \xff ,\x80", "H\xc3\xbc|\xff|\x80|"},
    };
    for (const auto& [what, text, tokens] : rows)
        EXPECT_EQ(Tokens(text), tokens) << what;

    std::string_view rest = "a:b,c \r\n d";
    EXPECT_EQ(NextToken(rest, ":"), "a");
    EXPECT_EQ(NextWord(rest), ":b,c");
    EXPECT_EQ(NextWord(rest), "d");
    EXPECT_EQ(NextWord(rest), "");
}

TEST(Text, LinesEndAtLineFeedsWithOrWithoutCarriageReturn)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"nothing", "", ""},
        {"LF and CR LF", "a\nb\r\nc\n", "a|b|c|"},
        {"empty lines", "\n\r\n\n", "|||"},
        {"no end at the last line", "a\nb", "a|b|"},
        {"a lone CR is a character", "a\rb\r\r\nc\r", "a\rb\r|c\r|"},
    };
    for (const auto& [what, text, lines] : rows)
        EXPECT_EQ(Lines(text), lines) << what;
}

TEST(Text, NamesCompareWithoutTheCaseOfAsciiOnly)
{
    EXPECT_TRUE(EqualNoCase("LeftUpLeg[1]", "LEFTupLEG[1]"));
    EXPECT_FALSE(EqualNoCase("Hip", "Hips"));
    EXPECT_FALSE(EqualNoCase("a[", "a{")); // 32 apart and no letters
    EXPECT_FALSE(EqualNoCase("\xc3\xa4", "\xc3\x84"));
    EXPECT_EQ(LowerCase("ÄZ@[a"), "Äz@[a");
    EXPECT_EQ(UpperCase("äz`{A"), "äZ`{A");
}

TEST(Text, BlanksAndMarksGoFromTheEndsOnly)
{
    EXPECT_EQ(CutTrailing(" a b \t\r\n"), " a b");
    EXPECT_EQ(CutTrailing(" \n"), "");
    EXPECT_EQ(SkipByteOrderMark("\xef\xbb\xbfHIERARCHY"), "HIERARCHY");
    EXPECT_EQ(SkipByteOrderMark("\xef\xbb"), "\xef\xbb");
}

TEST(Text, PrintableTextCommandsNoTerminal)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"plain", "Hips 1", "Hips 1"},
        {"letters beyond ASCII", "Hüfte 腰 🦴", "Hüfte 腰 🦴"},
        {"escape sequence", "\x1b[2J\x07\x7f", "\\x1b[2J\\x07\\x7f"},
        {"line feed", "a\n", "a\\x0a"},
        {"control of two bytes", "\xc2\x9b[2J", "\\xc2\\x9b[2J"},
        {"no-break space is none", "a\xc2\xa0 b", "a\xc2\xa0 b"},
        {"stray byte", "a\x9b[2J", "a\\x9b[2J"},
        {"cut sequence", "\xe8\x85", "\\xe8\\x85"},
        {"sequence without its end", "\xe8\x1b[", "\\xe8\\x1b["},
        {"overlong control", "\xc0\x9b", "\\xc0\\x9b"},
        {"overlong in three bytes", "\xe0\x80\x9b", "\\xe0\\x80\\x9b"},
        {"half of a surrogate pair", "\xed\xa0\x80", "\\xed\\xa0\\x80"},
        {"no code point", "\xf4\x90\x80\x80", "\\xf4\\x90\\x80\\x80"},
    };
    for (const auto& [what, text, printed] : rows)
        EXPECT_EQ(Printable(text), printed) << what;
}

TEST(Text, NearestNameIsASlipAwayOrNone)
{
    const std::vector<std::string> bones = {"Hips", "Spine", "LeftUpLeg", "RightUpLeg", "LeftLeg"};
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"case has no say", "leftupleg", "LeftUpLeg"},
        {"a letter too many", "Hipss", "Hips"},
        {"a letter too few", "Spne", "Spine"},
        {"a letter changed", "Spime", "Spine"},
        {"the nearer of two", "LftLeg", "LeftLeg"},
        {"another word", "Head", ""},
        {"nothing", "", ""},
        {"short and all different", "x", ""},
    };
    for (const auto& [what, name, nearest] : rows)
        EXPECT_EQ(NearestName(name, bones), nearest) << what;
    const std::string endless(1000000, 'x'); // would take minutes
    EXPECT_EQ(NearestName(endless, {endless}), "");
}

TEST(CFailureRecord, KeepsTheFirstFailureAndFewWarningsOfAReason)
{
    CFailureRecord record;
    EXPECT_FALSE(record.Failure());
    EXPECT_FALSE(record.Fail(EFailure::BadNumber, 7, "Hips"));
    record.Fail(EFailure::Truncated, 9);
    EXPECT_EQ(record.Failure().reason, EFailure::BadNumber);
    EXPECT_EQ(record.Failure().where, 7u);
    EXPECT_EQ(record.Failure().name, "Hips");

    for (size_t line = 1; line <= 100; ++line)
        record.Warn(EFailure::ShortRow, line);
    record.Warn(EFailure::StuckNumber, 200);
    ASSERT_EQ(record.Warnings().size(), 9u);
    EXPECT_EQ(record.Warnings().front().where, 1u);
    EXPECT_EQ(record.Warnings().back().reason, EFailure::StuckNumber);
    record.Clear();
    EXPECT_FALSE(record.Failure());
    EXPECT_THAT(record.Warnings(), testing::IsEmpty());
}

} // namespace gw
