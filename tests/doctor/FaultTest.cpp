// A healthy file with one fault at a time: exactly that fault is found and, if it can be repaired, the copy
// equals the healthy file.

#include "Examined.h"
#include "MadeWalk.h"

#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr int kFrame = 40; // a frame in the middle
constexpr size_t kHipX = 0;
constexpr size_t kThighX = 7; // Xrotation of LeftUpLeg

enum class EEnd
{
    Restored, // the repaired text equals the healthy one, byte for byte
    Mended,   // a different healthy text
    Stays,
};

struct FaultCase
{
    EEnd end;
    const char* what;
    std::string text;
    const char* code;
    size_t line;
};

std::string Wide(const std::string& walk)
{
    std::string wide = "\xff\xfe";
    for (const char c : walk)
        wide.append({c, '\0'});
    return wide;
}

// Lines refer to the made walk: 2 ROOT Hips, 6 JOINT LeftUpLeg, 10 JOINT LeftLeg, 101 MOTION.
std::vector<FaultCase> Cases()
{
    const std::string walk = MadeWalk();
    const size_t row = LineOfFrame(walk, kFrame);
    const size_t last = LineOfFrame(walk, 89);
    const size_t frames = LineOfFrame(walk, 0) - 2;
    const std::string noRows = walk.substr(0, walk.find(LineOf(walk, LineOfFrame(walk, 0))));
    const auto replace = [&](std::string_view part, std::string_view instead, std::string_view behind = {}) {
        return Replaced(walk, part, instead, behind);
    };
    const auto give = [&](const char* value) { return WithValues(walk, kFrame, kThighX, {value}); };
    const std::string values = LineOf(walk, row);
    const auto giveRow = [&](const std::string& changed) { return WithLine(walk, row, changed); };
    constexpr const char* kPointer = "version https://git-lfs.example/spec/v1\noid sha256:4d7a\nsize 12345\n";
    constexpr std::string_view kProp = "ROOT Prop\n{\nOFFSET 0 0 0\nCHANNELS 0\n}\nMOTION";
    using namespace std::string_view_literals;
    using enum EEnd;
    return {
        {Stays, "a pointer in place of the file", kPointer, "lfs-pointer", 1},
        {Stays, "16 bits a character", Wide(walk), "not-text", 0},
        {Restored, "a byte order mark", "\xef\xbb\xbf" + walk, "byte-order-mark", 1},
        {Restored, "a carriage return in a row", giveRow(Replaced(values, " ", "\r")), "carriage-return",
         row},
        {Mended, "a line end that was doubled", replace("\n", "\r\r\n", "Frames:"), "carriage-return",
         frames},
        {Restored, "a zero byte", replace("OFFSET 9", "OFFSET\0009"sv), "stray-character", 8},
        {Restored, "a no-break space", replace("OFFSET 9", "OFFSET\302\2409"), "stray-character", 8},
        {Restored, "a minus sign of typesetting", replace("-2.0", "\342\210\2222.0"), "stray-character", 8},
        {Restored, "an end mark of another system", walk + "\x1a", "stray-character", last + 1},

        {Restored, "a keyword in small letters", replace("HIERARCHY", "hierarchy"), "keyword-spelling", 1},
        {Restored, "a root in small letters", replace("ROOT", "Root"), "keyword-spelling", 2},
        {Restored, "an offset in small letters", replace("OFFSET 9", "offset 9"), "keyword-spelling", 8},
        {Restored, "a channel in small letters", replace("Zrotation", "ZRotation", "LeftUpLeg"),
         "keyword-spelling", 9},
        {Restored, "frames in small letters", replace("Frames:", "frames:"), "keyword-spelling", frames},
        {Restored, "no blank behind the colon", replace("Frames: ", "Frames:"), "keyword-spelling", frames},
        {Restored, "no colon", replace("Frame Time:", "Frame time"), "keyword-spelling", frames + 1},
        {Mended, "a brace behind a name", replace("LeftUpLeg\n\t{", "LeftUpLeg {"), "brace-on-line", 6},
        {Mended, "two braces on a line", replace("}\n\t\t\t\t}", "} }"), "brace-on-line", 25},
        {Mended, "a blank in a name", replace("LeftUpLeg", "Left Up Leg"), "blank-in-name", 6},
        {Mended, "a comma in a name", replace("ROOT Hips", "ROOT Hips,main"), "blank-in-name", 2},
        {Stays, "two joints of a name", replace("RightUpLeg", "LeftUpLeg"), "same-name", 30},
        {Stays, "channels that are not counted", replace("CHANNELS 3", "CHANNELS 2"), "channel-count", 9},
        {Stays, "fewer channels than counted", replace("CHANNELS 3", "CHANNELS 4"), "missing-tokens", 9},
        {Stays, "a channel that there is not", replace("Zrotation", "Wrotation", "LeftUpLeg"),
         "unknown-channel", 9},
        {Stays, "a second root", replace("MOTION", kProp), "second-root", frames - 1},
        {Stays, "a brace too few", replace("\n}\nMOTION", "\nMOTION"), "bad-brace", frames - 2},
        {Stays, "no number in an offset", replace("OFFSET 9.000000", "OFFSET nan"), "nan", 8},

        {Restored, "an empty line before the frames", replace("MOTION\n", "MOTION\n\n"),
         "empty-line-before-frames", frames},
        {Restored, "one behind them", replace("\n", "\n \t\n", "Frames:"), "empty-line-before-frames",
         frames + 1},
        {Restored, "one before the rows", replace("\n", "\n\n", "Frame Time:"), "empty-line-before-frames",
         frames + 2},
        {Restored, "one between the rows", giveRow('\n' + values), "empty-line-in-rows", row},
        {Stays, "a rate for a time", replace("0.033333", "30"), "rate-for-time", frames + 1},
        {Stays, "a time of nothing", replace("0.033333", "0"), "bad-number", frames + 1},
        {Restored, "too few rows", replace("Frames: 90", "Frames: 91"), "missing-rows", frames},
        {Restored, "far too few rows", replace("Frames: 90", "Frames: 2000000000"), "missing-rows", frames},
        {Restored, "too many rows", replace("Frames: 90", "Frames: 60"), "surplus-rows", frames},
        {Stays, "no row at all", noRows, "missing-rows", frames},
        {Stays, "no frame at all", Replaced(noRows, ": 90", ": 0"), "no-frames", frames},
        {Mended, "a last row that is cut", walk.substr(0, walk.rfind(' ')) + '\n', "short-row", last},
        {Stays, "a row that is cut", giveRow(values.substr(0, values.rfind(' '))), "short-row", row},
        {Stays, "a row that goes on", giveRow(values + " 1.5"), "long-row", row},
        {Mended, "no number in a row", give("nan"), "nan", row},
        {Mended, "no number as one system prints it", give("-1.#IND00"), "nan", row},
        {Mended, "an infinity in the first row", WithValues(walk, 0, kHipX, {"-inf"}), "nan",
         LineOfFrame(walk, 0)},
        {Stays, "a word in a row", give("x"), "stuck-number", row},
        {Stays, "a number with something stuck to it", give("1.5f"), "stuck-number", row},
    };
}

TEST(Faults, AreFoundOneByOneAndMended)
{
    const std::string walk = MadeWalk();
    for (const FaultCase& row : Cases())
    {
        SCOPED_TRACE(row.what);
        CExamined ill(row.text);
        EXPECT_EQ(ill.Found(), std::to_string(row.line) + ' ' + row.code);
        EXPECT_EQ(ill.Exam().Findings().MendsAny(), row.end != EEnd::Stays);
        if (row.end == EEnd::Stays)
            continue;
        const std::string mended = ill.Mended();
        EXPECT_TRUE(mended == walk || row.end == EEnd::Mended);
        CExamined copy(mended);
        EXPECT_EQ(copy.Found(), "");
        EXPECT_TRUE(copy.Loads());
    }
}

TEST(Faults, OfOneFileAreFoundTogetherAndMendedTogether)
{
    std::string ill = Replaced(MadeWalk(), "HIERARCHY", "Hierarchy");
    ill = Replaced(ill, "LeftUpLeg\n\t{", "Left UpLeg {");
    ill = Replaced(ill, "MOTION\nFrames: 90", "MOTION\n\nframes: 95");
    const size_t row = LineOfFrame(ill, kFrame) + 1;
    ill = WithValues(ill, kFrame + 1, kThighX, {"inf"});
    ill = WithLine(ill, row, '\n' + LineOf(ill, row));
    CExamined examined(ill);
    EXPECT_EQ(examined.Found(), "1 keyword-spelling, 6 blank-in-name, 6 brace-on-line, "
                                "127 empty-line-before-frames, 128 keyword-spelling, 128 missing-rows, "
                                "171 empty-line-in-rows, 172 nan");
    CExamined copy(examined.Mended());
    EXPECT_EQ(copy.Found(), "");
    EXPECT_TRUE(copy.Loads());
}

TEST(Faults, OfOneKindAreCountedBehindTheFirst)
{
    std::string ill = MadeWalk();
    for (int frame = 10; frame < 80; frame += 2)
        ill = WithValues(ill, frame, kThighX, {"nan"});
    const std::vector<Finding> found = CExamined(ill).Exam().Findings().Sorted();
    ASSERT_EQ(found.size(), 5u);
    EXPECT_EQ(found.back().more, 30u);
}

// A gap of one frame is interpolated; a longer one is not filled.
TEST(Faults, OfValuesAreMendedByTheirNeighbours)
{
    const std::string walk = MadeWalk();
    const std::string one = CExamined(WithValues(walk, kFrame, kThighX, {"nan"})).Mended();
    EXPECT_NEAR(ValueOf(one, kFrame, kThighX),
                (ValueOf(walk, kFrame - 1, kThighX) + ValueOf(walk, kFrame + 1, kThighX)) / 2.0, 1e-5);

    // The shorter way if angles jump by a whole turn.
    const std::string turned = WithValues(walk, kFrame - 1, kThighX, {"178", "nan", "-178"});
    EXPECT_NEAR(std::fabs(ValueOf(CExamined(turned).Mended(), kFrame, kThighX)), 180.0, 1e-5);

    const std::string long4 = WithValues(walk, kFrame, kThighX, {"nan", "nan", "nan", "nan"});
    EXPECT_FALSE(CExamined(long4).Exam().Findings().MendsAny());
}

TEST(Faults, OfAllLinesOrNumbersAreMended)
{
    const std::string walk = MadeWalk();
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"\n", "\r", "1 carriage-return, 2 carriage-return"},
        {".", ",", "4 decimal-comma, 8 decimal-comma"},
    };
    for (const auto& [part, instead, found] : rows)
    {
        CExamined ill(AllReplaced(walk, part, instead));
        EXPECT_TRUE(ill.Found().starts_with(found)) << ill.Found();
        EXPECT_EQ(ill.Found().find("row"), std::string::npos) << ill.Found();
        EXPECT_TRUE(ill.Mended() == walk);
    }
    // Commas that separate values are not decimal commas.
    EXPECT_EQ(CExamined(AllReplaced(walk, " 0.000000", ",0.000000")).Found(), "");
}

TEST(Faults, LeaveTheLineEndsOfAFile)
{
    const std::string crlf = AllReplaced(MadeWalk(), "\n", "\r\n");
    EXPECT_TRUE(CExamined(Replaced(crlf, "Frames: 90", "Frames: 12")).Mended() == crlf);
    EXPECT_TRUE(CExamined(Replaced(crlf, "MOTION", "motion")).Mended() == crlf);
    const std::string noEnd = MadeWalk().substr(0, MadeWalk().size() - 1);
    EXPECT_TRUE(CExamined(Replaced(noEnd, "Frames: 90", "Frames: 12")).Mended() == noEnd);
}

} // namespace
} // namespace gw
