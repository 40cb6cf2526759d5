// What an HTR file becomes and what is written of a motion.

#include "Angles.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CGraphCheck.h"
#include "CKeyframeControl.h"
#include "Euler.h"
#include "MotionTexts.h"
#include "Rotations.h"
#include "Skeleton.h"

#include <cmath>
#include <gtest/gtest.h>
#include <span>
#include <tuple>

namespace gw {
namespace {

constexpr double kTolerance = 1e-3; // degrees

std::string Chain(size_t depth)
{
    std::string text = "[Header]\nNumSegments 100000\n[SegmentNames&Hierarchy]\nS0 GLOBAL\n";
    for (size_t i = 1; i < depth; ++i)
        text.append("S").append(std::to_string(i)).append(" S").append(std::to_string(i - 1)).append("\n");
    return text;
}

TEST(TKHTRStream, RowsAreDeltasThatActBeforeTheBase)
{
    CLoadedMotion file(kSmallHTR, "a.htr");
    ASSERT_TRUE(file.loaded);
    EXPECT_EQ(RecordText(file.motion.Record()), "");
    EXPECT_EQ(file.motion.fileVersion, 3);
    EXPECT_EQ(file.motion.GetFrequency(), 0.04f);
    EXPECT_EQ(file.motion.GetLastFrame(), 1.0f);

    const Mat3 torsoBase = Mat3FromAxisAngle(kVec3UnitZ, kHalfPi);
    const Mat3 headBase = EulerToMat3("ZYX", {10, 20, 30});
    const CNode& head = PosedNode(file.motion, "Head", 1);
    const CNode& torso = *file.motion.motionRoot;
    EXPECT_LT(DegreesBetween(NormalizedRows(torso.m_kMatrix), headBase * torsoBase), kTolerance);
    EXPECT_LT(DegreesBetween(NormalizedRows(head.m_kMatrix), EulerToMat3("ZYX", {-5, 15, 25}) * headBase),
              kTolerance);
    EXPECT_NEAR(Vec3Length(RowLengths(torso.m_kMatrix)), 2 * std::sqrt(3.0), 1e-5) << "SF on all three axes";
    EXPECT_EQ(torso.m_kMatrix.Translation(), (Vec3{4, 105, 6}));

    CNode& rest = *file.motion.restRoot;
    EXPECT_EQ(TreeText(&rest), "Torso(Head)");
    EXPECT_EQ(rest.GetControl(), nullptr);
    EXPECT_LT(DegreesBetween(NormalizedRows(FindNode(&rest, "Head")->m_kMatrix), headBase), kTolerance);
    EXPECT_EQ(NodeBoneLength(rest), 50.0f);
    EXPECT_EQ(NodeBoneLength(torso), 50.0f);
    SwitchControls(*file.motion.motionRoot, false);
    EXPECT_EQ(PosedNode(file.motion, "Head", 1).m_kMatrix, FindNode(&rest, "Head")->m_kMatrix) << "rest pose";
}

TEST(TKHTRStream, ReadsTheSameMotionWhateverMeansNothing)
{
    const Change rows[] = {
        {"CR LF and a byte order mark", "", "\xef\xbb\xbf" + WithCarriageReturns(kSmallHTR)},
        {"blank lines in sections", "1 0 0 0 0 0 0 1\n2", "\n1 0 0 0 0 0 0 1\n \t\n2"},
        {"comments", "Torso 0 100", "#Torso 1 1 1\nTorso 0 100"},
        {"blank line in the header", "DataType", "\nDataType"},
        {"frames in any order", "2 0 0 0 -5", "-7 0 0 0 -5"},
        {"commas and tabs", "2 0 0 0 -5 15 25", "2,0, 0\t0,-5 , 15,25"},
        {"unknown key", "NumFrames", "Colour red\nNumFrames"},
        {"unknown section", "[Torso]", "[EndOfFile]\n1 2 3\n[Torso]"},
        {"more segments than lines", "NumSegments 2", "NumSegments 99"},
        {"longer words than fit", "Order ZYX", "Order ZYXr"},
    };
    ExpectSame(kSmallHTR, "a.htr", rows);
}

TEST(TKHTRStream, ReadsOddFilesAsTheyStand)
{
    const std::string noRows = "MissingSection 17 Head\n";
    const std::string lostHead = "UnknownSegment 21 Head\nUnknownSegment 27 [Head]\n";
    const Change rows[] = {
        {"a segment not counted", "ments 2", "ments 1", "BadCount 17 NumSegments\n" + lostHead, 2, "Torso"},
        {"unknown parent", "Head Torso", "Head Body", "UnknownSegment 17 Body\n" + lostHead, 2, "Torso"},
        {"two roots", "Head Torso", "Head GLOBAL", "", 2, "Torso"},
        {"section without an end", "[Head]", "[Head", "UnknownSegment 27 [Head\n" + noRows, 0},
        {"a row is missing", "2 0 0 0 -5 15 25 1\n", "", "TooFewRows 17 Head\n", 1},
        {"a row is short", "-5 15 25 1", "-5", "ShortRow 30 Head\n"},
        {"a row without values", "2 0 0 0 -5 15 25 1", "2", "ShortRow 30 Head\n"},
        {"key without value", "Factor 1.000000", "Factor", "MissingTokens 13 ScaleFactor\n"},
        {"used key without value", "mes 2", "mes", "MissingTokens 6 NumFrames\n"},
        {"two numbers in one", "2 0 0 0 -5", "2 0 0 0-5", "StuckNumber 30 0-5\n"},
        {"two sections", "[Head]", "[Head]\n1 2\n[Head]", "ShortRow 28 Head\n", 3},
        {"surplus row", "-5 15 25 1\n", "-5 15 25 1\n3 9 9 9 9 9 9 9\n", "", 3},
        {"base pose before its segment", "[Header]", "[BasePosition]\nTorso 1 2 3 0 0 0 9\n[Header]",
         "UnknownSegment 2 Torso\n"},
        {"fewer frames than none", "Frames 2", "Frames -2"},
    };
    ExpectRead(kSmallHTR, "a.htr", rows);
}

TEST(TKHTRStream, TakesTheHeaderAsItStands)
{
    CLoadedMotion unknownOrder(Changed(kSmallHTR, {"", "EulerRotationOrder ZYX", "EulerRotationOrder xyz"}),
                               "a.htr");
    EXPECT_EQ(NormalizedRows(PosedNode(unknownOrder.motion, "Head", 1).m_kMatrix), kMat3Identity);
    EXPECT_EQ(CLoadedMotion(Changed(kSmallHTR, {"", "FileVersion 3\n", ""}), "a.htr").motion.fileVersion, 1);

    CLoadedMotion noRate(Changed(kSmallHTR, {"", "DataFrameRate 25\n", ""}), "a.htr");
    ASSERT_TRUE(noRate.loaded);
    EXPECT_TRUE(std::isinf(noRate.motion.GetFrequency()));
    EXPECT_EQ(PosedNode(noRate.motion, "Torso", 1).m_kMatrix.Translation(), (Vec3{1, 102, 3}))
        << "begin time";
    ASSERT_TRUE(noRate.motion.Save(noRate.path, 1.0f));
    EXPECT_NE(ReadText(noRate.path).find("NumFrames 2\nDataFrameRate 0\n"), std::string::npos);

    CLoadedMotion axisX(Changed(kSmallHTR, {"", "BoneLengthAxis Y", "BoneLengthAxis X"}), "a.htr");
    const Mat4& mesh = FindBoneMesh(*axisX.motion.motionRoot)->m_kMatrix;
    EXPECT_LT(Vec3Length(TransformCoord(kVec3UnitY, mesh) - kVec3UnitX), 1e-6);
}

// A segment's rows of a number alone repeat the row above, and the first one is no change of the base pose.
TEST(TKHTRStream, RowsWithoutValuesRepeatTheRowAbove)
{
    const CLoadedMotion file(Changed(kSmallHTR, {"", "1 1 2 3 0 0 0 1\n", "1\n1 1 2 3 0 0 0 1\n2\n"}),
                             "a.htr");
    ASSERT_TRUE(file.loaded);
    const CKeyframeControl& torso = TrackOf(file.motion, "Torso");
    EXPECT_EQ(torso.m_kPositionKeys, (std::vector<Vec3>{{0, 100, 0}, {1, 102, 3}, {1, 102, 3}, {4, 105, 6}}));
    EXPECT_EQ(torso.m_kScaleKeys[0], kVec3One);
}

TEST(TKHTRStream, RefusesWithReasonAndLine)
{
    const Change rows[] = {
        {"other text", "", "HIERARCHY\n", "MissingSection 1 [SegmentNames&Hierarchy]"},
        {"no segments counted", "ments 2", "ments 0", "NoRoot 30 NumSegments"},
        {"count of segments missing", "NumSegments 2\n", "", "NoRoot 29 NumSegments"},
        {"a ring", "Torso GLOBAL", "Torso Head", "UnknownSegment 23 Torso"},
        {"absurdly many frames", "mes 2", "mes 2000000000", "BadCount 6 NumFrames"},
        {"frames beyond 32 bits", "mes 2", "mes 99999999999", "BadCount 6 NumFrames"},
        {"word as count", "Frames 2", "Frames two", "BadNumber 6 two"},
        {"endless scale factor", "1.000000", "inf", "BadNumber 13 inf"},
        {"word in the base pose", "Head 0 50", "Head 0 high", "BadNumber 21 high"},
        {"word in a row", "2 4 5 6", "2 4 x 6", "BadNumber 26 x"},
        {"row of words", "2 4 5 6", "Torso 4 5 6", "BadNumber 26 Torso"},
    };
    ExpectRefused(kSmallHTR, "a.htr", rows);
}

TEST(TKHTRStream, BoundsNamesAndNesting)
{
    const std::string text = Changed(kSmallHTR, {"", "Head Torso", std::string(256, 'n') + " Torso"});
    EXPECT_EQ(RecordText(CLoadedMotion(text, "a.htr").motion.Record()),
              "failed BadName 17 " + std::string(80, 'n') + "\n");
    EXPECT_TRUE(CLoadedMotion(Chain(kNestingLimit - 1), "a.htr").loaded);
    const CLoadedMotion deeper(Chain(kNestingLimit), "a.htr");
    EXPECT_EQ(RecordText(deeper.motion.Record()), "failed TooDeep 4003 S3999\n");
}

// Two frames of a root that moves and grows, and a child whose own translation does not reach the file.
constexpr std::string_view kMoving = R"([Header]
NumSegments 2
NumFrames 2
DataFrameRate 25
EulerRotationOrder XYZ
BoneLengthAxis Y
[SegmentNames&Hierarchy]
Torso GLOBAL
Head Torso
[BasePosition]
Torso 0 100 0 0 0 0 50
Head 0 50 0 0 0 0 20
[Torso]
1 1 2 3 0 0 0 1
2 2 4 -3 0 0 0 2
[Head]
1 0 0 0 0 0 0 1
2 5 5 5 0 0 0 1
)";

// What must become of it with these rows of the root.
std::string Written(const std::vector<std::string>& torso)
{
    const std::string columns = "#Fr\tTx\tTy\tTz\tRx\tRy\tRz\tSF\n";
    const std::string still = "0.000000 0.000000 0.000000 0.000000 0.000000 0.000000 1.000000";
    std::string torsoRows;
    std::string headRows;
    for (size_t row = 0; row < torso.size(); ++row)
    {
        const std::string number = std::to_string(row + 1) + " ";
        torsoRows += number + torso[row] + "\n";
        headRows += number + still + "\n";
    }
    return "\nDataFrameRate 25\nEulerRotationOrder ZYX\nCalibrationUnits mm\nRotationUnits Degrees\n"
           "GlobalAxisofGravity Y\nBoneLengthAxis Y\nScaleFactor 1.000000\n"
           "[SegmentNames&Hierarchy]\n#CHILD\tPARENT\nTorso GLOBAL\nHead Torso\n"
           "[BasePosition]\n#SegmentName Tx, Ty, Tz, Rx, Ry, Rz, BoneLength\n"
           "Torso 0.000000 100.000000 0.000000 0.000000 -0.000000 0.000000 50.000000\n"
           "Head 0.000000 50.000000 0.000000 0.000000 -0.000000 0.000000 20.000000\n"
           "#Beginning of Data. Separated by tabs\n[Torso]\n" +
           columns + torsoRows + "[Head]\n" + columns + headRows;
}

TEST(TKHTRStream, WritesTheseBytes)
{
    const std::string begin = "1.000000 2.000000 3.000000 0.000000 0.000000 0.000000 1.000000";
    const std::string middle = "1.500000 3.000000 0.000000 0.000000 0.000000 0.000000 1.500000";
    const std::string end = "2.000000 4.000000 -3.000000 0.000000 0.000000 0.000000 2.000000";
    const std::tuple<float, std::string, std::vector<std::string>> rows[] = {
        {1.0f, "2", {begin, end}}, {2.0f, "4", {begin, middle, end, end}},
        {0.5f, "1", {begin}},      {0.0f, "0", {}},
        {-1.0f, "-2", {}},
    };
    CLoadedMotion file(kMoving, "a.htr");
    ASSERT_TRUE(file.loaded);
    for (const auto& [frameScale, frames, torso] : rows)
    {
        SCOPED_TRACE(frameScale);
        ASSERT_TRUE(file.motion.Save(file.folder.Path("b.HTR"), frameScale));
        EXPECT_EQ(ReadText(file.folder.Path("b.HTR")),
                  "[Header]\nFileType htr\nDataType HTRS\nFileVersion 1\nNumSegments 2\nNumFrames " + frames +
                      Written(torso));
    }
}

TEST(TKHTRStream, SendsTheSavedTextInPiecesOfOneSize)
{
    CLoadedMotion file(kMoving, "a.htr");
    ASSERT_TRUE(file.motion.Save(file.path, 2000.0f));
    std::string sent;
    std::vector<size_t> sizes;
    const auto sink = [&](std::span<const std::byte> bytes) {
        sent.append(reinterpret_cast<const char*>(bytes.data()), bytes.size());
        sizes.push_back(bytes.size());
        return true;
    };
    ASSERT_TRUE(file.motion.SaveText(sink, 2000.0f, "head"));
    EXPECT_EQ(sent, "head" + ReadBytes(file.path));
    sizes.pop_back(); // the rest
    EXPECT_EQ(sizes, std::vector(sizes.size(), size_t{1} << 16));
}

// The node's local matrix in every frame of a written file at twice the frames, against the tree's own.
void ExpectSaved(CMotionFile& motion, const std::string& path, const char* name)
{
    CMotionFile again;
    ASSERT_TRUE(motion.Save(path, 2.0f));
    ASSERT_TRUE(again.Load(path));
    ASSERT_EQ(again.GetKeyCount(), 2 * motion.GetKeyCount());
    for (int frame = 0; frame < again.GetKeyCount(); ++frame)
    {
        motion.motionRoot->UpdateScene(static_cast<float>(frame) / 2 / motion.GetFrequency(), true);
        const Mat4& expected = FindNode(motion.motionRoot.Get(), name)->m_kMatrix;
        const Mat4& found = PosedNode(again, name, frame).m_kMatrix;
        EXPECT_LT(DegreesBetween(NormalizedRows(found), NormalizedRows(expected)), kTolerance) << frame;
    }
}

// Where nodes depend on each other the whole tree is posed for each frame, with the same outcome.
TEST(TKHTRStream, WritesThePosesOfTheTree)
{
    std::string text(kMoving);
    text.replace(text.find("2 5 5 5 0 0 0"), 13, "2 0 0 0 9 8 7");
    text.replace(text.find("2 2 4 -3 0 0 0 2"), 16, "2 2 4 -3 5 60 7 1");
    CLoadedMotion file(text, "a.htr");
    ASSERT_TRUE(file.loaded);
    const std::string path = file.folder.Path("b.htr");
    ExpectSaved(file.motion, path, "Head");
    const std::string plain = ReadBytes(path);

    auto* const track =
        static_cast<CKeyframeControl*>(FindNode(file.motion.motionRoot.Get(), "Head")->GetControl());
    track->m_uiParentMask = 0x38;
    ExpectSaved(file.motion, path, "Head");
    EXPECT_NE(ReadBytes(path), plain) << "the parent's rotation is undone";
    track->m_uiParentMask = 0;
    FindBoneMesh(*file.motion.motionRoot)->AttachControl(new CKeyframeControl);
    for (const float frameScale : {2.0f, 4.0f, 7.0f})
    {
        CLoadedMotion bySegments(text, "c.htr");
        ASSERT_TRUE(bySegments.motion.Save(bySegments.path, frameScale));
        ASSERT_TRUE(file.motion.Save(path, frameScale));
        EXPECT_EQ(ReadBytes(path), ReadBytes(bySegments.path))
            << "a control that has nothing to do with the nodes";
    }
}

// What is taken from memory after a save is what the file has, quarter turns and all.
TEST(TKHTRStream, QuarterTurnsReadBackWhereThatIsAskedFor)
{
    // flippedBy: read back from what the rule for all poses writes
    const std::pair<Vec3, double> rows[] = {
        {{0, 90, 0}, 180.0},     {{0, -90, 0}, 180.0}, {{30, 90, 40}, 180.0},
        {{-20, -90, 70}, 180.0}, {{5, 89.9f, 3}, 0.0}, {{5, 60, 3}, 0.0},
    };
    for (const auto& [degrees, flippedBy] : rows)
    {
        SCOPED_TRACE(degrees.x + degrees.y);
        for (const EQuarterTurns turns : {EQuarterTurns::ReadBack, EQuarterTurns::Flipped})
        {
            CLoadedMotion file(kMoving, "a.htr");
            file.motion.quarterTurns = turns;
            CNode& head = *FindNode(file.motion.motionRoot.Get(), "Head");
            const Mat3 turn = EulerToMat3("ZYX", degrees);
            static_cast<CKeyframeControl*>(head.GetControl())->m_kRotationKeys[1] = QuatFromMat3(turn);
            const std::string path = file.folder.Path("b.htr");
            ASSERT_TRUE(file.motion.Save(path, 1.0f));
            CMotionFile written;
            ASSERT_TRUE(written.Load(path));
            const Mat3 read = NormalizedRows(PosedNode(written, "Head", 1).m_kMatrix);
            if (turns == EQuarterTurns::ReadBack)
                EXPECT_LT(DegreesBetween(read, turn), kTolerance);
            else
                EXPECT_NEAR(DegreesBetween(read, turn), flippedBy, 0.1);
            TakeWrittenPoses(file.motion);
            EXPECT_LT(DegreesBetween(NormalizedRows(PosedNode(file.motion, "Head", 1).m_kMatrix), read),
                      kTolerance);
        }
    }
}

// A name means the first of its bearers, and each of them has a section of its own when the motion is
// written.
TEST(TKHTRStream, TellsSegmentsOfOneNameApart)
{
    std::string text = Changed(kSmallHTR, {"", "Head Torso\n", "Head Torso\nHead Torso\n"});
    text.replace(text.find("NumSegments 2"), 13, "NumSegments 3");
    CLoadedMotion file(text, "a.htr");
    ASSERT_TRUE(file.loaded);
    EXPECT_EQ(TreeText(file.motion.motionRoot.Get()), "Torso(Head Head)");
    EXPECT_EQ(RecordText(file.motion.Record()), "MissingSection 18 Head\n") << "the second one";
    ASSERT_TRUE(file.motion.Save(file.path, 1.0f));
    const std::string written = ReadBytes(file.path);
    const size_t first = written.find("[Head]");
    const size_t second = written.find("[Head]", first + 1);
    ASSERT_NE(second, written.npos);
    const std::string still = "0.000000 0.000000 0.000000 ";
    EXPECT_NE(written.substr(first, second - first).find("\n2 " + still + "4.376245 8.184834 30.469891 "),
              written.npos);
    EXPECT_NE(written.find("\n2 " + still + still, second), written.npos);
}

TEST(TKHTRStream, KeepsTheSkeletonFromFileToFile)
{
    CLoadedMotion file(kSmallHTR, "a.htr");
    const Mat4 base = FindNode(file.motion.restRoot.Get(), "Head")->m_kMatrix;
    for (int i = 0; i < 3; ++i)
    {
        ASSERT_TRUE(file.motion.Save(file.path, 1.0f));
        ASSERT_TRUE(file.motion.Load(file.path));
        const Mat4& again = FindNode(file.motion.restRoot.Get(), "Head")->m_kMatrix;
        EXPECT_LT(DegreesBetween(NormalizedRows(again), NormalizedRows(base)), kTolerance);
        EXPECT_EQ(again.Translation(), base.Translation());
        EXPECT_EQ(NodeBoneLength(*file.motion.restRoot), 50.0f);
    }
}

} // namespace
} // namespace gw
