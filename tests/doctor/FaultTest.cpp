// A healthy file with one fault at a time: exactly that fault is found and, if it can be repaired, the copy
// equals the healthy file.

#include "Examined.h"
#include "MadeWalk.h"

#include <cmath>
#include <functional>
#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr int kFrame = 40; // a frame in the middle
constexpr size_t kHipX = 0;
constexpr size_t kThighX = 7; // Xrotation of LeftUpLeg

using Change = std::function<std::string(const std::string& walk)>;

Change Replace(std::string_view part, std::string_view instead, std::string_view behind = {})
{
    return [=](const std::string& walk) { return Replaced(walk, part, instead, behind); };
}

Change ChangeRow(int frame, const std::function<std::string(std::string row)>& change)
{
    return [=](const std::string& walk) {
        const size_t line = LineOfFrame(walk, frame);
        return WithLine(walk, line, change(LineOf(walk, line)));
    };
}

Change GiveValue(int frame, size_t column, std::string_view value)
{
    return ChangeRow(frame, [=](const std::string& row) { return WithValue(row, column, value); });
}

std::string WithoutLastValue(const std::string& row)
{
    return row.substr(0, row.rfind(' '));
}

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
    Change change;
    const char* code;
    size_t line;
};

FaultCase Restored(const char* what, const Change& change, const char* code, size_t line)
{
    return {EEnd::Restored, what, change, code, line};
}

FaultCase Mended(const char* what, const Change& change, const char* code, size_t line)
{
    return {EEnd::Mended, what, change, code, line};
}

FaultCase Stays(const char* what, const Change& change, const char* code, size_t line)
{
    return {EEnd::Stays, what, change, code, line};
}

std::string ReturnForBlank(const std::string& row)
{
    return Replaced(row, " ", "\r");
}

std::string Pointer(const std::string&)
{
    return "version https://git-lfs.example/spec/v1\noid sha256:4d7a\nsize 12345\n";
}

std::string Wide(const std::string& walk)
{
    std::string wide = "\xff\xfe";
    for (const char c : walk)
        wide.append({c, '\0'});
    return wide;
}

std::string WithoutRows(const std::string& walk)
{
    return walk.substr(0, walk.find(LineOf(walk, LineOfFrame(walk, 0))));
}

Change Around(std::string_view before, std::string_view behind)
{
    return [=](const std::string& walk) { return std::string(before) + walk + std::string(behind); };
}

// Lines refer to the made walk: 2 ROOT Hips, 6 JOINT LeftUpLeg, 10 JOINT LeftLeg, 101 MOTION.
std::vector<FaultCase> Cases()
{
    const std::string walk = MadeWalk();
    const size_t row = LineOfFrame(walk, kFrame);
    const size_t last = LineOfFrame(walk, 89);
    const size_t frames = LineOfFrame(walk, 0) - 2;
    const Change noFrame = [](const std::string& t) { return Replaced(WithoutRows(t), ": 90", ": 0"); };
    const auto putEmptyBefore = [](const std::string& r) { return std::string(1, '\n') + r; };
    const auto goOn = [](const std::string& r) { return r + " 1.5"; };
    constexpr std::string_view kProp = "ROOT Prop\n{\nOFFSET 0 0 0\nCHANNELS 0\n}\nMOTION";
    using namespace std::string_view_literals;
    return {
        Stays("a pointer in place of the file", Pointer, "lfs-pointer", 1),
        Stays("16 bits a character", Wide, "not-text", 0),
        Restored("a byte order mark", Around("\xef\xbb\xbf", ""), "byte-order-mark", 1),
        Restored("a carriage return in a row", ChangeRow(kFrame, ReturnForBlank), "carriage-return", row),
        Mended("a line end that was doubled", Replace("\n", "\r\r\n", "Frames:"), "carriage-return", frames),
        Restored("a zero byte", Replace("OFFSET 9", "OFFSET\0009"sv), "stray-character", 8),
        Restored("a no-break space", Replace("OFFSET 9", "OFFSET\302\2409"), "stray-character", 8),
        Restored("a minus sign of typesetting", Replace("-2.0", "\342\210\2222.0"), "stray-character", 8),
        Restored("an end mark of another system", Around("", "\x1a"), "stray-character", last + 1),

        Restored("a keyword in small letters", Replace("HIERARCHY", "hierarchy"), "keyword-spelling", 1),
        Restored("a root in small letters", Replace("ROOT", "Root"), "keyword-spelling", 2),
        Restored("an offset in small letters", Replace("OFFSET 9", "offset 9"), "keyword-spelling", 8),
        Restored("a channel in small letters", Replace("Zrotation", "ZRotation", "LeftUpLeg"),
                 "keyword-spelling", 9),
        Restored("frames in small letters", Replace("Frames:", "frames:"), "keyword-spelling", frames),
        Restored("no blank behind the colon", Replace("Frames: ", "Frames:"), "keyword-spelling", frames),
        Restored("no colon", Replace("Frame Time:", "Frame time"), "keyword-spelling", frames + 1),
        Mended("a brace behind a name", Replace("LeftUpLeg\n\t{", "LeftUpLeg {"), "brace-on-line", 6),
        Mended("two braces on a line", Replace("}\n\t\t\t\t}", "} }"), "brace-on-line", 25),
        Mended("a blank in a name", Replace("LeftUpLeg", "Left Up Leg"), "blank-in-name", 6),
        Mended("a comma in a name", Replace("ROOT Hips", "ROOT Hips,main"), "blank-in-name", 2),
        Stays("two joints of a name", Replace("RightUpLeg", "LeftUpLeg"), "same-name", 30),
        Stays("channels that are not counted", Replace("CHANNELS 3", "CHANNELS 2"), "channel-count", 9),
        Stays("fewer channels than counted", Replace("CHANNELS 3", "CHANNELS 4"), "missing-tokens", 9),
        Stays("a channel that there is not", Replace("Zrotation", "Wrotation", "LeftUpLeg"),
              "unknown-channel", 9),
        Stays("a second root", Replace("MOTION", kProp), "second-root", frames - 1),
        Stays("a brace too few", Replace("\n}\nMOTION", "\nMOTION"), "bad-brace", frames - 2),
        Stays("no number in an offset", Replace("OFFSET 9.000000", "OFFSET nan"), "nan", 8),

        Restored("an empty line before the frames", Replace("MOTION\n", "MOTION\n\n"),
                 "empty-line-before-frames", frames),
        Restored("one behind them", Replace("\n", "\n \t\n", "Frames:"), "empty-line-before-frames",
                 frames + 1),
        Restored("one before the rows", Replace("\n", "\n\n", "Frame Time:"), "empty-line-before-frames",
                 frames + 2),
        Restored("one between the rows", ChangeRow(kFrame, putEmptyBefore), "empty-line-in-rows", row),
        Stays("a rate for a time", Replace("0.033333", "30"), "rate-for-time", frames + 1),
        Stays("a time of nothing", Replace("0.033333", "0"), "bad-number", frames + 1),
        Restored("too few rows", Replace("Frames: 90", "Frames: 91"), "missing-rows", frames),
        Restored("far too few rows", Replace("Frames: 90", "Frames: 2000000000"), "missing-rows", frames),
        Restored("too many rows", Replace("Frames: 90", "Frames: 60"), "surplus-rows", frames),
        Stays("no row at all", WithoutRows, "missing-rows", frames),
        Stays("no frame at all", noFrame, "no-frames", frames),
        Mended("a last row that is cut", ChangeRow(89, WithoutLastValue), "short-row", last),
        Stays("a row that is cut", ChangeRow(kFrame, WithoutLastValue), "short-row", row),
        Stays("a row that goes on", ChangeRow(kFrame, goOn), "long-row", row),
        Mended("no number in a row", GiveValue(kFrame, kThighX, "nan"), "nan", row),
        Mended("no number as one system prints it", GiveValue(kFrame, kThighX, "-1.#IND00"), "nan", row),
        Mended("an infinity in the first row", GiveValue(0, kHipX, "-inf"), "nan", LineOfFrame(walk, 0)),
        Stays("a word in a row", GiveValue(kFrame, kThighX, "x"), "stuck-number", row),
        Stays("a number with something stuck to it", GiveValue(kFrame, kThighX, "1.5f"), "stuck-number", row),
    };
}

TEST(Faults, AreFoundOneByOneAndMended)
{
    const std::string walk = MadeWalk();
    for (const FaultCase& row : Cases())
    {
        SCOPED_TRACE(row.what);
        CExamined ill(row.change(walk));
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
    ill = WithLine(ill, row, '\n' + WithValue(LineOf(ill, row), kThighX, "inf"));
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
        ill = GiveValue(frame, kThighX, "nan")(ill);
    const std::vector<Finding> found = CExamined(ill).Exam().Findings().Sorted();
    ASSERT_EQ(found.size(), 5u);
    EXPECT_EQ(found.back().more, 30u);
}

// A gap of one frame is interpolated; a longer one is not filled.
TEST(Faults, OfValuesAreMendedByTheirNeighbours)
{
    const std::string walk = MadeWalk();
    const std::string one = CExamined(GiveValue(kFrame, kThighX, "nan")(walk)).Mended();
    EXPECT_NEAR(ValueOf(one, kFrame, kThighX),
                (ValueOf(walk, kFrame - 1, kThighX) + ValueOf(walk, kFrame + 1, kThighX)) / 2.0, 1e-5);

    // The shorter way if angles jump by a whole turn.
    std::string turned = GiveValue(kFrame - 1, kThighX, "178")(walk);
    turned = GiveValue(kFrame, kThighX, "nan")(GiveValue(kFrame + 1, kThighX, "-178")(turned));
    EXPECT_NEAR(std::fabs(ValueOf(CExamined(turned).Mended(), kFrame, kThighX)), 180.0, 1e-5);

    std::string long4 = walk;
    for (int frame = kFrame; frame < kFrame + 4; ++frame)
        long4 = GiveValue(frame, kThighX, "nan")(long4);
    EXPECT_FALSE(CExamined(long4).Exam().Findings().MendsAny());
}

TEST(Faults, OfLineEndsAreMended)
{
    const std::string walk = MadeWalk();
    CExamined old(AllReplaced(walk, "\n", "\r"));
    EXPECT_TRUE(old.Found().starts_with("1 carriage-return, 2 carriage-return")) << old.Found();
    EXPECT_TRUE(old.Mended() == walk);
}

TEST(Faults, OfDecimalCommasAreMended)
{
    const std::string walk = MadeWalk();
    CExamined ill(AllReplaced(walk, ".", ","));
    EXPECT_TRUE(ill.Found().starts_with("4 decimal-comma, 8 decimal-comma")) << ill.Found();
    EXPECT_EQ(ill.Found().find("row"), std::string::npos) << ill.Found();
    EXPECT_TRUE(ill.Mended() == walk);
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
