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
#include <tuple>

namespace gw {
namespace {

constexpr double kTolerance = 1e-3; // degrees

// The small file with one piece of text replaced. An empty `from` stands for the whole text.
struct Change
{
    const char* what;
    std::string from;
    std::string to;
};

std::string Changed(const Change& change)
{
    std::string text(kSmallHTR);
    const size_t at = text.find(change.from);
    EXPECT_NE(at, text.npos) << change.from;
    return change.from.empty() ? change.to : text.replace(at, change.from.size(), change.to);
}

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
        {"surplus row", "-5 15 25 1\n", "-5 15 25 1\n3 9 9 9 9 9 9 9\n"},
    };
    CLoadedMotion plain(kSmallHTR, "a.htr");
    const Mat4 expected = PosedNode(plain.motion, "Head", 1).m_kWorldMatrix;
    for (const Change& row : rows)
    {
        SCOPED_TRACE(row.what);
        CLoadedMotion file(Changed(row), "a.htr");
        ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
        EXPECT_EQ(PosedNode(file.motion, "Head", 1).m_kWorldMatrix, expected);
        EXPECT_EQ(file.motion.GetKeyCount(), 2);
        EXPECT_EQ(RecordText(file.motion.Record()), "");
    }
}

TEST(TKHTRStream, ReadsOddFilesAsTheyStand)
{
    const std::string noRows = "MissingSection 17 Head\n";
    const char* const lostHead = "UnknownSegment 21 Head\nUnknownSegment 27 [Head]\n";
    const std::tuple<Change, const char*, size_t, std::string> rows[] = {
        {{"a segment not counted", "ments 2", "ments 1"}, "Torso", 0, "BadCount 17 NumSegments\n*"},
        {{"unknown parent", "Head Torso", "Head Body"}, "Torso", 0, "UnknownSegment 17 Body\n*"},
        {{"two roots", "Head Torso", "Head GLOBAL"}, "Torso", 0, ""},
        {{"section without an end", "[Head]", "[Head"},
         "Torso(Head)",
         0,
         "UnknownSegment 27 [Head\n" + noRows},
        {{"a row is missing", "2 0 0 0 -5 15 25 1\n", ""}, "Torso(Head)", 1, "TooFewRows 17 Head\n"},
        {{"a row is short", "-5 15 25 1", "-5"}, "Torso(Head)", 2, "ShortRow 30 Head\n"},
        {{"a row without values", "2 0 0 0 -5 15 25 1", "2"}, "Torso(Head)", 2, "ShortRow 30 Head\n"},
        {{"key without value", "Factor 1.000000", "Factor"},
         "Torso(Head)",
         2,
         "MissingTokens 13 ScaleFactor\n"},
        {{"used key without value", "mes 2", "mes"}, "Torso(Head)", 2, "MissingTokens 6 NumFrames\n"},
        {{"two numbers in one", "2 0 0 0 -5", "2 0 0 0-5"}, "Torso(Head)", 2, "StuckNumber 30 0-5\n"},
        {{"two sections", "[Head]", "[Head]\n1 2\n[Head]"}, "Torso(Head)", 3, "ShortRow 28 Head\n"},
        {{"fewer frames than none", "Frames 2", "Frames -2"}, "Torso(Head)", 2, ""},
    };
    for (const auto& [change, tree, headKeys, recorded] : rows)
    {
        SCOPED_TRACE(change.what);
        const CLoadedMotion file(Changed(change), "a.htr");
        ASSERT_TRUE(file.loaded);
        std::string record = recorded;
        if (record.ends_with('*'))
            record.replace(record.size() - 1, 1, lostHead);
        EXPECT_EQ(RecordText(file.motion.Record()), record);
        ASSERT_EQ(TreeText(file.motion.motionRoot.Get()), tree);
        const bool hasHead = FindNode(file.motion.motionRoot.Get(), "Head") != nullptr;
        EXPECT_EQ(hasHead ? TrackOf(file.motion, "Head").m_kRotationKeys.size() : 0, headKeys);
    }
}

TEST(TKHTRStream, TakesTheHeaderAsItStands)
{
    CLoadedMotion unknownOrder(Changed({"", "EulerRotationOrder ZYX", "EulerRotationOrder xyz"}), "a.htr");
    EXPECT_EQ(NormalizedRows(PosedNode(unknownOrder.motion, "Head", 1).m_kMatrix), kMat3Identity);
    EXPECT_EQ(CLoadedMotion(Changed({"", "FileVersion 3\n", ""}), "a.htr").motion.fileVersion, 1);

    CLoadedMotion noRate(Changed({"", "DataFrameRate 25\n", ""}), "a.htr");
    ASSERT_TRUE(noRate.loaded);
    EXPECT_TRUE(std::isinf(noRate.motion.GetFrequency()));
    EXPECT_EQ(PosedNode(noRate.motion, "Torso", 1).m_kMatrix.Translation(), (Vec3{1, 102, 3}))
        << "begin time";
    ASSERT_TRUE(noRate.motion.Save(noRate.path, 1.0f));
    EXPECT_NE(ReadBytes(noRate.path).find("NumFrames 2\nDataFrameRate 0\n"), std::string::npos);

    CLoadedMotion axisX(Changed({"", "BoneLengthAxis Y", "BoneLengthAxis X"}), "a.htr");
    const Mat4& mesh = FindBoneMesh(*axisX.motion.motionRoot)->m_kMatrix;
    EXPECT_LT(Vec3Length(TransformCoord(kVec3UnitY, mesh) - kVec3UnitX), 1e-6);
}

// A segment's rows of a number alone repeat the row above, and the first one is no change of the base pose.
TEST(TKHTRStream, RowsWithoutValuesRepeatTheRowAbove)
{
    const CLoadedMotion file(Changed({"", "1 1 2 3 0 0 0 1\n", "1\n1 1 2 3 0 0 0 1\n2\n"}), "a.htr");
    ASSERT_TRUE(file.loaded);
    const CKeyframeControl& torso = TrackOf(file.motion, "Torso");
    EXPECT_EQ(torso.m_kPositionKeys, (std::vector<Vec3>{{0, 100, 0}, {1, 102, 3}, {1, 102, 3}, {4, 105, 6}}));
    EXPECT_EQ(torso.m_kScaleKeys[0], kVec3One);
}

TEST(TKHTRStream, RefusesWithReasonAndLine)
{
    const std::tuple<Change, const char*> rows[] = {
        {{"no bytes", "", ""}, "MissingSection 0 [SegmentNames&Hierarchy]"},
        {{"other text", "", "HIERARCHY\n"}, "MissingSection 1 [SegmentNames&Hierarchy]"},
        {{"no segments counted", "ments 2", "ments 0"}, "NoRoot 30 NumSegments"},
        {{"count of segments missing", "NumSegments 2\n", ""}, "NoRoot 29 NumSegments"},
        {{"a ring", "Torso GLOBAL", "Torso Head"}, "UnknownSegment 23 Torso"},
        {{"a ring of one", "Torso GLOBAL", "Torso Torso"}, "UnknownSegment 23 Torso"},
        {{"absurdly many frames", "mes 2", "mes 2000000000"}, "BadCount 6 NumFrames"},
        {{"frames beyond 32 bits", "mes 2", "mes 99999999999"}, "BadCount 6 NumFrames"},
        {{"word as count", "Frames 2", "Frames two"}, "BadNumber 6 two"},
        {{"endless scale factor", "1.000000", "inf"}, "BadNumber 13 inf"},
        {{"word in the base pose", "Head 0 50", "Head 0 high"}, "BadNumber 21 high"},
        {{"word in a row", "2 4 5 6", "2 4 x 6"}, "BadNumber 26 x"},
        {{"not a number in a row", "2 4 5 6", "2 4 nan 6"}, "BadNumber 26 nan"},
        {{"number too big for a float", "2 4 5 6", "2 4 1e39 6"}, "BadNumber 26 1e39"},
        {{"row that is no row", "2 4 5 6", "Torso 4 5 6"}, "BadNumber 26 Torso"},
    };
    for (const auto& [change, recorded] : rows)
    {
        SCOPED_TRACE(change.what);
        const CLoadedMotion file(Changed(change), "a.htr");
        EXPECT_FALSE(file.loaded);
        const std::string record = RecordText(file.motion.Record());
        EXPECT_EQ(record.substr(0, record.find('\n')), std::string("failed ") + recorded);
    }
}

TEST(TKHTRStream, BoundsNamesAndNesting)
{
    const std::string text = Changed({"", "Head Torso", std::string(256, 'n') + " Torso"});
    EXPECT_EQ(RecordText(CLoadedMotion(text, "a.htr").motion.Record()),
              "failed BadName 17 " + std::string(80, 'n') + "\n");
    EXPECT_TRUE(CLoadedMotion(Chain(kNestingLimit - 1), "a.htr").loaded);
    const CLoadedMotion deeper(Chain(kNestingLimit), "a.htr");
    EXPECT_EQ(RecordText(deeper.motion.Record()), "failed TooDeep 4003 S3999\n");
}

TEST(TKHTRStream, ValuesOfSegmentsThatComeLaterAreLost)
{
    const std::string base = "Torso 0 100 0 0 0 90 50\n";
    const CLoadedMotion file("[BasePosition]\n" + base + Changed({"", base, ""}), "a.htr");
    ASSERT_TRUE(file.loaded);
    EXPECT_EQ(file.motion.restRoot->m_kMatrix, kMat4Identity);
    EXPECT_EQ(RecordText(file.motion.Record()), "UnknownSegment 2 Torso\n");
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

// What must become of it, but for the rows.
std::string Written(const std::string& frames, const std::string& torso, const std::string& head)
{
    const std::string columns = "#Fr\tTx\tTy\tTz\tRx\tRy\tRz\tSF\n";
    return "[Header]\nFileType htr\nDataType HTRS\nFileVersion 1\nNumSegments 2\nNumFrames " + frames +
           "\nDataFrameRate 25\nEulerRotationOrder ZYX\nCalibrationUnits mm\nRotationUnits Degrees\n"
           "GlobalAxisofGravity Y\nBoneLengthAxis Y\nScaleFactor 1.000000\n"
           "[SegmentNames&Hierarchy]\n#CHILD\tPARENT\nTorso GLOBAL\nHead Torso\n"
           "[BasePosition]\n#SegmentName Tx, Ty, Tz, Rx, Ry, Rz, BoneLength\n"
           "Torso 0.000000 100.000000 0.000000 0.000000 -0.000000 0.000000 50.000000\n"
           "Head 0.000000 50.000000 0.000000 0.000000 -0.000000 0.000000 20.000000\n"
           "#Beginning of Data. Separated by tabs\n[Torso]\n" +
           columns + torso + "[Head]\n" + columns + head;
}

TEST(TKHTRStream, WritesTheseBytes)
{
    const std::string turn = " 0.000000 0.000000 0.000000 ";
    const std::string begin = "1.000000 2.000000 3.000000" + turn + "1.000000\n";
    const std::string middle = "1.500000 3.000000 0.000000" + turn + "1.500000\n";
    const std::string end = "2.000000 4.000000 -3.000000" + turn + "2.000000\n";
    const std::string still = "0.000000 0.000000 0.000000" + turn + "1.000000\n";
    const auto rowsOf = [](std::initializer_list<std::string> rows) {
        std::string text;
        for (int number = 1; const std::string& row : rows)
            text.append(std::to_string(number++)).append(" ").append(row);
        return text;
    };
    const std::tuple<const char*, float, const char*, std::string, std::string> rows[] = {
        {"as it is", 1.0f, "2", rowsOf({begin, end}), rowsOf({still, still})},
        {"twice", 2.0f, "4", rowsOf({begin, middle, end, end}), rowsOf({still, still, still, still})},
        {"half", 0.5f, "1", rowsOf({begin}), rowsOf({still})},
        {"nothing", 0.0f, "0", "", ""},
        {"below nothing", -1.0f, "-2", "", ""},
    };
    CLoadedMotion file(kMoving, "a.htr");
    ASSERT_TRUE(file.loaded);
    for (const auto& [what, frameScale, frames, torso, head] : rows)
    {
        SCOPED_TRACE(what);
        ASSERT_TRUE(file.motion.Save(file.folder.Path("b.HTR"), frameScale));
        EXPECT_EQ(ReadBytes(file.folder.Path("b.HTR")), Written(frames, torso, head));
    }
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
    const struct
    {
        Vec3 degrees;
        double flippedBy; // read back from what the rule for all poses writes
    } rows[] = {
        {{0, 90, 0}, 180.0},     {{0, -90, 0}, 180.0}, {{30, 90, 40}, 180.0},
        {{-20, -90, 70}, 180.0}, {{5, 89.9f, 3}, 0.0}, {{5, 60, 3}, 0.0},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.degrees.x + row.degrees.y);
        for (const EQuarterTurns turns : {EQuarterTurns::ReadBack, EQuarterTurns::Flipped})
        {
            CLoadedMotion file(kMoving, "a.htr");
            file.motion.quarterTurns = turns;
            CNode& head = *FindNode(file.motion.motionRoot.Get(), "Head");
            const Mat3 turn = EulerToMat3("ZYX", row.degrees);
            static_cast<CKeyframeControl*>(head.GetControl())->m_kRotationKeys[1] = QuatFromMat3(turn);
            const std::string path = file.folder.Path("b.htr");
            ASSERT_TRUE(file.motion.Save(path, 1.0f));
            CMotionFile written;
            ASSERT_TRUE(written.Load(path));
            const Mat3 read = NormalizedRows(PosedNode(written, "Head", 1).m_kMatrix);
            if (turns == EQuarterTurns::ReadBack)
                EXPECT_LT(DegreesBetween(read, turn), kTolerance);
            else
                EXPECT_NEAR(DegreesBetween(read, turn), row.flippedBy, 0.1);
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
    std::string text = Changed({"", "Head Torso\n", "Head Torso\nHead Torso\n"});
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
    const std::string whole(kSmallHTR);
    const std::string head = whole.substr(0, whole.find("[BasePosition]"));
    for (int i = 0; i < 3; ++i)
    {
        ASSERT_TRUE(file.motion.Save(file.path, 1.0f));
        EXPECT_TRUE(ReadBytes(file.path).starts_with(head)) << "header and hierarchy";
        ASSERT_TRUE(file.motion.Load(file.path));
        const Mat4& again = FindNode(file.motion.restRoot.Get(), "Head")->m_kMatrix;
        EXPECT_LT(DegreesBetween(NormalizedRows(again), NormalizedRows(base)), kTolerance);
        EXPECT_EQ(again.Translation(), base.Translation());
        EXPECT_EQ(NodeBoneLength(*file.motion.restRoot), 50.0f);
    }
}

} // namespace
} // namespace gw
