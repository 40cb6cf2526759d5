// What a CHA file becomes, and what is refused.

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "MotionTexts.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TKCHAStream.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

const std::string kLastRow = "Head 1, 0, 0, 0, 0, 1, 0, -1, 0, 0, 52, 0\n";

TEST(TKCHAStream, RowsAreLocalMatricesAndPositions)
{
    CLoadedMotion file(kSmallCHA, "a.cha");
    ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
    EXPECT_EQ(RecordText(file.motion.Record()), "");
    EXPECT_EQ(file.motion.GetFrequency(), 0.04f);
    EXPECT_EQ(file.motion.GetKeyCount(), 3);
    ExpectNear(PosedNode(file.motion, "Torso", 1).m_kMatrix,
               Mat4{{0, 1, 0, 0, -1, 0, 0, 0, 0, 0, 1, 0, 4, 5, 6, 1}}, 1e-5);

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

    CLoadedMotion later(Changed(kSmallCHA, {"", "BeginFrame 0", "BeginFrame 1"}), "a.cha");
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
        {"no line end at the end", kLastRow, kLastRow.substr(0, kLastRow.size() - 1)},
        {"a row more than segments", kLastRow, kLastRow + "[END]\n"},
    };
    ExpectSame(kSmallCHA, "a.cha", rows);
}

TEST(TKCHAStream, ReadsOddFilesAsTheyStand)
{
    const Change rows[] = {
        {"unknown parent", "Head Torso", "Head Body", "UnknownSegment 13 Body\nUnknownSegment 23 Head\n", 3,
         "Torso"},
        {"parent in small letters", "Head Torso", "Head global",
         "UnknownSegment 13 global\nUnknownSegment 23 Head\n", 3, "Torso"},
        {"two roots", "Head Torso", "Head Global", "", 3, "Torso"},
        {"two of a name", "Head Torso", "Torso Global", "UnknownSegment 23 Head\nTooFewRows 23 Torso\n", 3,
         "Torso"},
        {"a line that is not counted", "Head Torso", "Head Torso\nTail Head", "BadCount 14 NumSegments\n"},
        {"no length", "Head 20.5", "Head", "MissingTokens 10 Head\n"},
        {"a row that names nothing", "Head 1, 0, 0, 0, 0", "Hand 1, 0, 0, 0, 0",
         "UnknownSegment 23 Hand\nTooFewRows 23 Head\n", 0},
        {"a header that is not closed", "2\n\n[L", "2\n[L", "OpenHeader 13 [HEADER]\n", 0},
        {"a name alone", "Head 1, 0, 0, 0, 0, 1, 0, -1, 0, 0, 52, 0", "He", "ShortRow 23 He\n"},
        {"a key without value", "Number 100", "Number", "MissingTokens 2 VersionNumber\n"},
        {"a frame more", kLastRow, kLastRow + "Frame 3\nTorso 0\nHead 0\n",
         "ShortRow 25 Torso\nShortRow 26 Head\n"},
        {"no frames", "EndFrame 2", "EndFrame -9", "", 0},
    };
    ExpectRead(kSmallCHA, "a.cha", rows);
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
        CLoadedMotion file(Changed(kSmallCHA, change), "a.cha");
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
    const Change rows[] = {
        {"other text", "", "HIERARCHY\n", "MissingSection 1 [HIERARCHY]"},
        {"a blank line at the top", "[HEADER]", "\n[HEADER]", "BlankLine 1 [HIERARCHY]"},
        {"two blank lines", "\n\n", "\n\n\n", "BlankLine 8 [HIERARCHY]"},
        {"no motion", "[MOTION]", "[MOVES]", "MissingSection 23 [MOTION]"},
        {"no root", "Torso Global", "Torso Head", "NoRoot 14 Global"},
        {"no count of segments", "NumSegments 2\n", "", "NoRoot 13 NumSegments"},
        {"a word as value", "EndFrame 2", "EndFrame two", "BadNumber 5 two"},
        {"a begin before 0", "BeginFrame 0", "BeginFrame -1", "BadNumber 4 -1"},
        {"101 segments", "ments 2", "ments 101", "TooLarge 6 NumSegments"},
        {"101 rows", "", Segments(101), "TooLarge 108 S100"},
        {"a word as length", "Head 20.5", "Head long", "BadNumber 10 long"},
        {"a long name", "Head Torso", std::string(256, 'A'), "BadName 13 " + std::string(80, 'A')},
        {"a word in a row", "0, 52, 0", "0, x, 0", "BadNumber 23 x"},
        {"no number in a row", "0, 52, 0", "0, nan, 0", "BadNumber 23 nan"},
        {"fewer rows", kLastRow, "", "TooFewRows 22 Head"},
        {"a segment more", "ments 2", "ments 3", "TooFewRows 23 "},
        {"frames without end", "EndFrame 2", "EndFrame 2147483647", "TooFewRows 14 EndFrame"},
        {"a far begin", "BeginFrame 0\nEndFrame 2", "BeginFrame 2147483645\nEndFrame 2147483647",
         "TooFewRows 14 EndFrame"},
        {"frames without end and rows", "EndFrame 2\nNumSegments 2\n", "EndFrame 2000000000\nNumSegments 2",
         "BadCount 22 EndFrame"},
    };
    ExpectRefused(kSmallCHA, "a.cha", rows);
}

} // namespace
} // namespace gw
