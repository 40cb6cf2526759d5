// What the grammar of a BVH file takes and refuses.

#include "CGraphCheck.h"
#include "CKeyframeControl.h"
#include "MotionTexts.h"
#include "Skeleton.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

std::string Chain(size_t depth)
{
    std::string text = "HIERARCHY\nROOT J\n{\n";
    for (size_t i = 1; i < depth; ++i)
        text += "JOINT J\n{\n";
    for (size_t i = 0; i < depth; ++i)
        text += "}\n";
    return text + "MOTION\nFrames: 0\nFrame Time: 1\n";
}

TEST(TKBVHStream, ReadsTheSameMotionWhateverMeansNothing)
{
    const Change rows[] = {
        {"CR LF and a byte order mark", "", "\xef\xbb\xbf" + WithCarriageReturns(kSmallBVH)},
        {"CR LF on some lines", "Hips\n{\n", "Hips\r\n{\r\n"},
        {"text before and after", "", "a note\n\n" + std::string(kSmallBVH) + "\nmore\n1 2\n"},
        {"lines that mean nothing", "\tOFFSET 0 10", "\n\tCOLOUR red\n\tOFFSET 0 10"},
        {"commas in a row", "11 21 31 10", ",11,21, 31,,10"},
        {"tabs and blanks around a row", "11 21 31 10", "\t 11 \t21\t31 10"},
        {"numbers of every form", "11 21 31 10", "+11. 0.21e2 31.000000000000000000000 1.0E+01"},
        {"no line end at the end", "0 0 0 90\n", "0 0 0 90"},
        {"surplus values", "40 50 60", "40 50 60 70 80"},
    };
    ExpectSame(kSmallBVH, "a.bvh", rows);
}

TEST(TKBVHStream, ReadsOddFilesAsTheyStand)
{
    const Change rows[] = {
        {"a joint called Site", "JOINT Chest", "JOINT Site", "", 3, "Hips(Site)"},
        {"a joint below an end site", "\t\t\tOFFSET 0 0 5", "JOINT Tip\n{\n}\n"},
        {"a joint outside all blocks", "MOTION", "JOINT Tail\n{\n}\nMOTION", "", 0, "Hips(Chest Tail)"},
        {"two roots", "MOTION", "ROOT Prop\n{\nCHANNELS 1 Xrotation\n}\nMOTION"},
        {"scale channels have no effect", "3 Xrotation", "3 Xscale"},
        {"surplus rows", "Frames: 3", "Frames: 2", "", 2},
        {"less than no frames", "Frames: 3", "Frames: -7", "", 0},
        {"name of three words", "ROOT Hips", "ROOT Hips of mine", "CutName 2 Hips\n"},
        {"unknown channel", "3 Xrotation Y", "3 Xrotation W", "UnknownChannel 9 Wrotation\n"},
        {"offset with an end", "OFFSET 1 2 3", "OFFSET 1 2 3;", "StuckNumber 4 3;\n"},
        {"two numbers in one", "12 22 32", "12 22.5-7 32", "StuckNumber 21 22.5-7\n"},
        {"short row", "40 50 60", "40 50", "ShortRow 20 Chest\n"},
    };
    ExpectRead(kSmallBVH, "a.bvh", rows);
}

TEST(TKBVHStream, RefusesWithReasonAndLine)
{
    const Change rows[] = {
        {"root without a name", "ROOT Hips", "ROOT ", "BadName 2 "},
        {"two opening braces", "\tOFFSET 1", "{\n\tOFFSET 1", "BadBrace 4 {"},
        {"no opening brace", "{\n\tOFFSET 1", "\tOFFSET 1", "BadBrace 14 }"},
        {"block without an end", "}\nMOTION", "MOTION", "BadBrace 15 }"},
        {"short offset", "OFFSET 0 10 0", "OFFSET 0 10", "MissingTokens 8 Chest"},
        {"word as offset", "OFFSET 0 10 0", "OFFSET 0 ten 0", "BadNumber 8 ten"},
        {"a channel fewer than counted", "6 Xpos", "7 Xpos", "MissingTokens 5 Hips"},
        {"absurd count of channels", "6 Xpos", "2000000000 Xpos", "MissingTokens 5 Hips"},
        {"no count of channels", "LS 3 Xrot", "LS Xrot", "BadNumber 9 Xrotation"},
        {"blank line behind MOTION", "Frames", "\nFrames", "BlankLine 17 Frames:"},
        {"other line behind MOTION", "Frames:", "Frames", "UnexpectedLine 17 Frames:"},
        {"frame time as a word", "Frame T", "FrameT", "UnexpectedLine 18 Frame Time:"},
        {"no count of frames", "Frames: 3", "Frames:", "MissingTokens 17 Frames:"},
        {"word as count of frames", "Frames: 3", "Frames: x", "BadNumber 17 x"},
        {"frame time 0", "0.04", "0", "BadNumber 18 0"},
        {"frame time 0 as a float", "0.04", "1e-99", "BadNumber 18 1e-99"},
        {"fewer rows than frames", "s: 3", "s: 4", "TooFewRows 17 Frames:"},
        {"absurdly many frames", "s: 3", "s: 2000000000", "TooFewRows 17 Frames:"},
        {"row too short for the root", "30 0 0 0 0", "30 0 0\n", "MissingTokens 19 Hips"},
        {"blank row", "11 21", "\n11 21", "BlankLine 20 "},
        {"word in a row", "31 10", "31 ten", "BadNumber 20 ten"},
        {"infinity in a row", "31 10", "31 inf", "BadNumber 20 inf"},
        {"other text", "", "a letter\nto you\n", "MissingSection 2 HIERARCHY"},
        {"hierarchy alone", "", "HIERARCHY\nROOT a\n{\n}\n", "MissingSection 4 MOTION"},
        {"hierarchy without a root", "", "HIERARCHY\nMOTION\n", "NoRoot 2 ROOT"},
        {"joint before any root", "", "HIERARCHY\nJOINT a\n{\n}\n", "NoRoot 2 a"},
    };
    ExpectRefused(kSmallBVH, "a.bvh", rows);
}

TEST(TKBVHStream, BoundsNamesAndNesting)
{
    const auto named = [](size_t length) {
        return Changed(kSmallBVH, {"", "Chest", std::string(length, 'n')});
    };
    EXPECT_TRUE(CLoadedMotion(named(255), "a.bvh").loaded);
    EXPECT_EQ(RecordText(CLoadedMotion(named(256), "a.bvh").motion.Record()),
              "failed BadName 6 " + std::string(80, 'n') + "\n");
    EXPECT_TRUE(CLoadedMotion(Chain(kNestingLimit - 1), "a.bvh").loaded);
    const CLoadedMotion deeper(Chain(kNestingLimit), "a.bvh");
    EXPECT_EQ(RecordText(deeper.motion.Record()), "failed TooDeep 8000 J\n");
}

// A row is one line of the file however long it is, and a number that a buffer would cut is whole.
TEST(TKBVHStream, ReadsRowsOfAnyLength)
{
    constexpr int kJoints = 800;
    std::string text = "HIERARCHY\nROOT J\n{\nCHANNELS 1 Xposition\n";
    std::string row = "0.5";
    for (int i = 1; i < kJoints; ++i)
    {
        text += "JOINT J" + std::to_string(i) + "\n{\nCHANNELS 1 Xposition\n}\n";
        row.append(" ").append(std::to_string(1000000 + i));
    }
    const CLoadedMotion file(text + "}\nMOTION\nFrames: 1\nFrame Time: 1\n" + row + "\n", "a.bvh");
    ASSERT_TRUE(file.loaded);
    ASSERT_GT(row.size(), 4096u);
    const std::vector<CNode*> nodes = NodesOf(*file.motion.motionRoot);
    ASSERT_EQ(nodes.size(), size_t{kJoints});
    for (size_t i = 1; i < nodes.size(); ++i)
        ASSERT_EQ(nodes[i]->m_kMatrix.Translation().x, static_cast<float>(1000000 + i)) << i;
}

// Joints without channels and end sites take no place in a row, so the file may be small for its frames.
TEST(TKBVHStream, ReadsManyFramesOfJointsWithoutChannels)
{
    const auto still = [](int frameCount) {
        std::string text = "HIERARCHY\nROOT R\n{\nCHANNELS 1 Xposition\n";
        for (int i = 0; i < 200; ++i)
            text += "JOINT J\n{\nEnd Site\n{\n}\n}\n";
        text += "}\nMOTION\nFrames: " + std::to_string(frameCount) + "\nFrame Time: 1\n";
        for (int i = 0; i < frameCount; ++i)
            text += "0\n";
        return text;
    };
    const CLoadedMotion file(still(40000), "a.bvh");
    EXPECT_TRUE(file.loaded) << RecordText(file.motion.Record());
    EXPECT_EQ(file.motion.GetKeyCount(), 40000);
    EXPECT_EQ(RecordText(CLoadedMotion(still(400000), "a.bvh").motion.Record()),
              "failed TooLarge 1207 Frames:\n");
}

// Values that a short row leaves out move the later ones up, so that keys are one fewer and the last one is
// filled up.
TEST(TKBVHStream, ValuesBehindAShortRowMoveUp)
{
    const CLoadedMotion file(
        "HIERARCHY\nROOT R\n{\nCHANNELS 1 Xposition\nJOINT J\n{\nCHANNELS 2 Xposition Yposition\n"
        "JOINT K\n{\nCHANNELS 1 Zposition\n}\n}\n}\nMOTION\nFrames: 3\nFrame Time: 1\n"
        "0 1 2 9\n0 3\n0 4 5 9\n",
        "a.bvh");
    ASSERT_TRUE(file.loaded);
    CNode* const joint = FindNode(file.motion.motionRoot.Get(), "J");
    const auto& keys = static_cast<CKeyframeControl*>(joint->GetControl())->m_kPositionKeys;
    EXPECT_EQ(keys, (std::vector<Vec3>{{1, 2, 0}, {3, 4, 0}, {5, 0, 0}}));
    EXPECT_EQ(file.motion.GetKeyCount(), 3);
}

TEST(TKBVHStream, WarnsOfPositionsThatRepeatTheOffsets)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"0 10 0", "0 10 0", "DoubledOffsets 14 J\n"},
        {"0 10 0", "0.01 9.99 0", "DoubledOffsets 14 J\n"},
        {"0 10 0", "0 11 0", ""},
        {"0 0 0", "0 0 0", ""},
    };
    for (const auto& [offset, position, record] : rows)
    {
        const std::string text =
            std::string("HIERARCHY\nROOT R\n{\nCHANNELS 1 Xposition\nJOINT J\n{\nOFFSET ") + offset +
            "\nCHANNELS 3 Xposition Yposition Zposition\n}\n}\nMOTION\nFrames: 1\nFrame Time: 1\n7 " +
            position + "\n";
        EXPECT_EQ(RecordText(CLoadedMotion(text, "a.bvh").motion.Record()), record) << position;
    }
}

} // namespace
} // namespace gw
