// What a CHA file becomes, and what is refused.

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "MotionTexts.h"
#include "Skeleton.h"
#include "TKCHAStream.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

// The small file with one piece of text replaced. An empty `from` stands for the whole text.
struct Change
{
    const char* what;
    std::string from;
    std::string to;
};

std::string Changed(const Change& change)
{
    std::string text(kSmallCHA);
    const size_t at = text.find(change.from);
    EXPECT_NE(at, text.npos) << change.from;
    return change.from.empty() ? change.to : text.replace(at, change.from.size(), change.to);
}

const std::string kLastRow = "Head 1, 0, 0, 0, 0, 1, 0, -1, 0, 0, 52, 0\n";

// Where the head stands at the last frame, as the file says it: turned about X, above a torso that is turned
// by half a turn.
const Mat4 kHeadAtTheEnd{{-1, 0, 0, 0, 0, 0, 1, 0, 0, 1, 0, 0, 7, -44, 9, 1}};

void ExpectNear(const Mat4& found, const Mat4& expected)
{
    for (int i = 0; i < 16; ++i)
        EXPECT_NEAR(found.m[i], expected.m[i], 1e-5) << i;
}

TEST(TKCHAStream, RowsAreLocalMatricesAndPositions)
{
    CLoadedMotion file(kSmallCHA, "a.cha");
    ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
    EXPECT_EQ(RecordText(file.motion.Record()), "");
    EXPECT_EQ(file.motion.GetFrequency(), 0.04f);
    EXPECT_EQ(file.motion.GetKeyCount(), 3);
    ExpectNear(PosedNode(file.motion, "Torso", 1).m_kMatrix,
               Mat4{{0, 1, 0, 0, -1, 0, 0, 0, 0, 0, 1, 0, 4, 5, 6, 1}});

    const CKeyframeControl& head = TrackOf(file.motion, "Head");
    EXPECT_EQ(head.m_kRestMatrix, Mat4Compose(kMat3Identity, {0, 50, 0})) << "the first position, unturned";
    EXPECT_EQ(head.m_kScaleKeys, std::vector<Vec3>(3, kVec3One));
    EXPECT_EQ(NodeBoneLength(*FindNode(file.motion.motionRoot.Get(), "Head")), 20.5f);
    EXPECT_EQ(FindBoneMesh(*file.motion.motionRoot)->m_kMatrix, kMat4Identity);
    EXPECT_FALSE(TKCHAStream().WriteFile(file.folder.Path("b.cha")));
}

// The end of a motion is one frame before its last, whatever the begin frame.
TEST(TKCHAStream, EndsOneFrameEarly)
{
    CLoadedMotion plain(kSmallCHA, "a.cha");
    EXPECT_EQ(plain.motion.GetLastFrame(), 1.0f);
    EXPECT_EQ(PosedNode(plain.motion, "Torso", 2).m_kMatrix.Translation(), (Vec3{4, 5, 6}));

    CLoadedMotion later(Changed({"", "BeginFrame 0", "BeginFrame 1"}), "a.cha");
    EXPECT_EQ(later.motion.GetKeyCount(), 2);
    EXPECT_EQ(later.motion.GetLastFrame(), 1.0f);
    EXPECT_EQ(PosedNode(later.motion, "Torso", 0).m_kMatrix.Translation(), (Vec3{4, 5, 6}));
    EXPECT_EQ(PosedNode(later.motion, "Torso", 1).m_kMatrix.Translation(), (Vec3{7, 8, 9}));
    EXPECT_EQ(TrackOf(later.motion, "Head").m_kRestMatrix.Translation(), (Vec3{0, 51, 0}));
}

TEST(TKCHAStream, ReadsTheSameMotionWhateverMeansNothing)
{
    const Change rows[] = {
        {"CR LF and a byte order mark", "", "\xef\xbb\xbf" + WithCarriageReturns(kSmallCHA)},
        {"text before the header", "[HEADER]", "made by hand\n[HEADER]"},
        {"remarks in the header", "DataFrame", "# remark\nColour 5\nDataFrame"},
        {"a comma behind a key", "Rate 25", "Rate,25.9"},
        {"blank lines in sections", "Torso 50", "\n \t\nTorso 50"},
        {"remarks in the lengths", "Torso 50", "# 1\n7 7\n-Head 9\n Head 9\n\xc3\x84 9\nTorso 50"},
        {"remarks in the hierarchy", "Head Torso", "#Head Global\nHead Torso"},
        {"remarks in the rows", "Frame 1", "12 rows\n\nFrame 1"},
        {"another word for a frame", "Frame 1", "F"},
        {"another length of a name", "Head 20.5", "Head 20.5\nHead 99"},
        {"another version", "Number 100", "Number 722"},
        {"no blanks in a row", "0, 52, 0", "0,52,0"},
        {"a remark behind a row", "0, 52, 0", "0, 52, 0 see above"},
        {"a frame more", kLastRow, kLastRow + "Frame 3\nTorso 0\nHead 0\n"},
        {"no line end at the end", kLastRow, kLastRow.substr(0, kLastRow.size() - 1)},
        {"a row more than segments", kLastRow, kLastRow + "[END]\n"},
    };
    for (const Change& row : rows)
    {
        SCOPED_TRACE(row.what);
        CLoadedMotion file(Changed(row), "a.cha");
        ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
        EXPECT_EQ(file.motion.GetKeyCount(), 3);
        EXPECT_EQ(file.motion.GetFrequency(), 0.04f);
        EXPECT_EQ(NodeBoneLength(*FindNode(file.motion.motionRoot.Get(), "Head")), 20.5f);
        const_cast<CKeyframeControl&>(TrackOf(file.motion, "Torso")).m_fEndTime = 2.0f;
        const_cast<CKeyframeControl&>(TrackOf(file.motion, "Head")).m_fEndTime = 2.0f;
        ExpectNear(PosedNode(file.motion, "Head", 2).m_kWorldMatrix, kHeadAtTheEnd);
    }
}

TEST(TKCHAStream, ReadsOddFilesAsTheyStand)
{
    const std::tuple<Change, const char*, size_t, const char*> rows[] = {
        {{"unknown parent", "Head Torso", "Head Body"},
         "Torso",
         0,
         "UnknownSegment 13 Body\nUnknownSegment 23 Head\n"},
        {{"parent in small letters", "Head Torso", "Head global"},
         "Torso",
         0,
         "UnknownSegment 13 global\nUnknownSegment 23 Head\n"},
        {{"two roots", "Head Torso", "Head Global"}, "Torso", 0, ""},
        {{"two of a name", "Head Torso", "Torso Global"},
         "Torso",
         0,
         "UnknownSegment 23 Head\nTooFewRows 23 Torso\n"},
        {{"a line that is not counted", "Head Torso", "Head Torso\nTail Head"},
         "Torso(Head)",
         3,
         "BadCount 14 NumSegments\n"},
        {{"no length", "Head 20.5", "Head"}, "Torso(Head)", 3, "MissingTokens 10 Head\n"},
        {{"a row that names nothing", "Head 1, 0, 0, 0, 0", "Hand 1, 0, 0, 0, 0"},
         "Torso(Head)",
         0,
         "UnknownSegment 23 Hand\nTooFewRows 23 Head\n"},
        {{"a header that is not closed", "2\n\n[L", "2\n[L"}, "Torso(Head)", 0, "OpenHeader 13 [HEADER]\n"},
        {{"a name alone", "Head 1, 0, 0, 0, 0, 1, 0, -1, 0, 0, 52, 0", "He"},
         "Torso(Head)",
         3,
         "ShortRow 23 He\n"},
        {{"a key without value", "Number 100", "Number"},
         "Torso(Head)",
         3,
         "MissingTokens 2 VersionNumber\n"},
        {{"no frames", "EndFrame 2", "EndFrame -9"}, "Torso(Head)", 0, ""},
    };
    for (const auto& [change, tree, headKeys, record] : rows)
    {
        SCOPED_TRACE(change.what);
        const CLoadedMotion file(Changed(change), "a.cha");
        ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
        EXPECT_EQ(RecordText(file.motion.Record()), record);
        ASSERT_EQ(TreeText(file.motion.motionRoot.Get()), tree);
        const bool hasHead = FindNode(file.motion.motionRoot.Get(), "Head") != nullptr;
        EXPECT_EQ(hasHead ? TrackOf(file.motion, "Head").m_kRotationKeys.size() : 0, headKeys);
    }
}

// Numbers behind a missing comma are not read: those of the segment's row before stay.
TEST(TKCHAStream, ShortRowsKeepTheNumbersBefore)
{
    const std::tuple<Change, Vec3> rows[] = {
        {{"no comma before the position", "1, 4, 5, 6", "1 4, 5, 6"}, {1, 2, 3}},
        {{"a blank before a comma", "1, 4, 5, 6", "1, 4 , 5, 6"}, {4, 2, 3}},
        {{"a letter behind a number", "1, 4, 5, 6", "1, 4, 5x, 6"}, {4, 5, 3}},
        {{"two commas", "1, 4, 5, 6", "1, 4,, 6"}, {4, 2, 3}},
        {{"the end of the line", "1, 4, 5, 6", "1, 4"}, {4, 2, 3}},
        {{"a name alone", " 0, 1, 0, -1, 0, 0, 0, 0, 1, 4, 5, 6", ""}, {1, 2, 3}},
    };
    for (const auto& [change, position] : rows)
    {
        SCOPED_TRACE(change.what);
        CLoadedMotion file(Changed(change), "a.cha");
        ASSERT_TRUE(file.loaded);
        EXPECT_EQ(RecordText(file.motion.Record()), "ShortRow 19 Torso\n");
        EXPECT_EQ(PosedNode(file.motion, "Torso", 1).m_kMatrix.Translation(), position);
    }
}

std::string Segments(int count)
{
    std::string text = "[HEADER]\nNumSegments 100\n\n[HIERARCHY]\nS0 Global\n[MOTION]\nFrame 0\n";
    for (int i = 0; i < count; ++i)
        text.append("S").append(std::to_string(i)).append(" 1,0,0,0,1,0,0,0,1,0,0,0\n");
    return text;
}

TEST(TKCHAStream, RefusesWithReasonAndLine)
{
    const std::tuple<Change, const char*> rows[] = {
        {{"no bytes", "", ""}, "MissingSection 0 [HIERARCHY]"},
        {{"other text", "", "HIERARCHY\n"}, "MissingSection 1 [HIERARCHY]"},
        {{"a blank line at the top", "[HEADER]", "\n[HEADER]"}, "BlankLine 1 [HIERARCHY]"},
        {{"two blank lines", "\n\n", "\n\n\n"}, "BlankLine 8 [HIERARCHY]"},
        {{"no hierarchy", "[HIERARCHY]", "[HIERARCHIES]"}, "MissingSection 14 [HIERARCHY]"},
        {{"no motion", "[MOTION]", "[MOVES]"}, "MissingSection 23 [MOTION]"},
        {{"no root", "Torso Global", "Torso Head"}, "NoRoot 14 Global"},
        {{"no count of segments", "NumSegments 2\n", ""}, "NoRoot 13 NumSegments\nBadCount 12 NumSegments"},
        {{"a word as value", "EndFrame 2", "EndFrame two"}, "BadNumber 5 two"},
        {{"a begin before 0", "BeginFrame 0", "BeginFrame -1"}, "BadNumber 4 -1"},
        {{"101 segments", "ments 2", "ments 101"}, "TooLarge 6 NumSegments"},
        {{"101 rows", "", Segments(101)}, "TooLarge 108 S100"},
        {{"a word as length", "Head 20.5", "Head long"}, "BadNumber 10 long"},
        {{"an endless length", "Head 20.5", "Head inf"}, "BadNumber 10 inf"},
        {{"a long name", "Head Torso", std::string(256, 'A')}, "BadName 13 *"},
        {{"a word in a row", "0, 52, 0", "0, x, 0"}, "BadNumber 23 x"},
        {{"no number in a row", "0, 52, 0", "0, nan, 0"}, "BadNumber 23 nan"},
        {{"more than any float", "0, 52, 0", "0, 1e39, 0"}, "BadNumber 23 1e39"},
        {{"fewer rows", kLastRow, ""}, "TooFewRows 22 Head"},
        {{"a frame more", "EndFrame 2", "EndFrame 3"}, "TooFewRows 23 Torso"},
        {{"a segment more", "ments 2", "ments 3"}, "TooFewRows 23 "},
        {{"frames without end", "EndFrame 2", "EndFrame 2147483647"}, "TooFewRows 14 EndFrame"},
        {{"a far begin", "BeginFrame 0\nEndFrame 2", "BeginFrame 2147483645\nEndFrame 2147483647"},
         "TooFewRows 14 EndFrame"},
        {{"frames without end and rows", "EndFrame 2\nNumSegments 2\n", "EndFrame 2000000000\nNumSegments 2"},
         "OpenHeader"},
    };
    for (const auto& [change, recorded] : rows)
    {
        SCOPED_TRACE(change.what);
        const CLoadedMotion file(Changed(change), "a.cha");
        EXPECT_FALSE(file.loaded);
        EXPECT_FALSE(file.motion.motionRoot);
        std::string record = recorded;
        if (record.ends_with('*'))
            record.replace(record.size() - 1, 1, std::string(80, 'A'));
        const std::string found = RecordText(file.motion.Record());
        if (record == "OpenHeader")
            record = "BadCount 22 EndFrame\nOpenHeader 13 [HEADER]";
        EXPECT_EQ(found, "failed " + record + "\n");
    }
}

TEST(TKCHAStream, NoBeginningOfAFileMovesHalfASegment)
{
    const CTempFolder folder;
    for (size_t end = 0; end < kSmallCHA.size(); ++end)
    {
        WriteBytes(folder.Path("a.cha"), kSmallCHA.substr(0, end));
        CMotionFile motion;
        if (!motion.Load(folder.Path("a.cha")))
            continue;
        EXPECT_GT(end + kLastRow.size(), kSmallCHA.size()) << end << ": only the last row may be short";
        EXPECT_EQ(TrackOf(motion, "Head").m_kRotationKeys.size(), 3u) << end;
        EXPECT_TRUE(IsFinite(*motion.motionRoot)) << end;
    }
}

} // namespace
} // namespace gw
