// What a CHB file becomes, and what is refused, byte by byte.

#include "BoneMeshQueries.h"
#include "CKeyframeControl.h"
#include "ERROBJ.h"
#include "MotionTexts.h"
#include "Rotations.h"
#include "TKCHBStream.h"

#include <cstring>
#include <gtest/gtest.h>
#include <limits>
#include <optional>
#include <tuple>

namespace gw {
namespace {

constexpr size_t kIntOffsets[] = {21, 38, 52, 64, 79}; // of version, rate, begin, end, segments
constexpr size_t kBegin = 2;
constexpr size_t kEnd = 3;
constexpr size_t kSegments = 4;
constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr size_t kFirstName = 91;    // behind "[LENGTH]"
constexpr size_t kFirstFrame = 1659; // of the small file, the number behind "Frame"
constexpr size_t kFrameBytes = 9 + 2 * 48;

template <class T>
std::string Bytes(T value)
{
    std::string bytes(sizeof value, '\0');
    std::memcpy(bytes.data(), &value, sizeof value);
    return bytes;
}

std::string Name(std::string name)
{
    name.resize(256);
    return name;
}

std::string Pose(const Mat3& matrix, const Vec3& position)
{
    return Bytes(matrix) + Bytes(position);
}

constexpr Mat3 kQuarterTurn{{0, 1, 0, -1, 0, 0, 0, 0, 1}};

// Frame i of two segments: the torso stands at (i, 0, 0), unturned; the head above it at height 10 + i,
// turned by a quarter about Z.
std::string FrameBytes(int i)
{
    return "Frame" + Bytes(i) + Pose(kMat3Identity, {static_cast<float>(i), 0, 0}) +
           Pose(kQuarterTurn, {0, 10.0f + static_cast<float>(i), 0});
}

std::string SmallCHB(int begin, int end)
{
    std::string bytes = "[HEADER]VersionNumber" + Bytes(721) + "DataFrameRate" + Bytes(30) + "BeginFrame" +
                        Bytes(begin) + "EndFrame" + Bytes(end) + "NumSegments" + Bytes(2) + "[LENGTH]" +
                        Name("Head") + Bytes(20.5f) + Name("Torso") + Bytes(50.0f) + "[HIERARCHY]" +
                        Name("Torso") + Name("Global") + Name("Head") + Name("Torso") + "[MOTION]";
    for (int i = begin; i <= end; ++i)
        bytes += FrameBytes(i);
    return bytes;
}

// A row of a table that puts bytes in the place of others or behind the end.
struct Patch
{
    const char* what;
    size_t at;
    std::string bytes;
    std::string record;
    const char* text = ""; ///< of a file that is refused: what is thrown; of others: the tree
};

std::string Patched(std::string bytes, size_t at, std::string_view patch)
{
    return bytes.replace(at, patch.size(), patch);
}

// What the stream itself throws at a file.
std::optional<ERROBJ> Thrown(const CTempFolder& folder, const std::string& bytes)
{
    WriteBytes(folder.Path("a.chb"), bytes);
    TKCHBStream stream;
    try
    {
        stream.Load(folder.Path("a.chb"));
    } catch (const ERROBJ& error)
    {
        EXPECT_TRUE(stream.Record().Failure());
        return error;
    }
    return std::nullopt;
}

TEST(TKCHBStream, ReadsMatricesAndPositions)
{
    CLoadedMotion file(SmallCHB(0, 3), "a.chb");
    ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
    EXPECT_EQ(RecordText(file.motion.Record()), "");
    EXPECT_EQ(TreeText(file.motion.motionRoot.Get()), "Torso(Head)");
    EXPECT_EQ(file.motion.GetFrequency(), 0.06f) << "whatever the rate in the file";
    EXPECT_EQ(file.motion.GetLastFrame(), 3.0f);
    EXPECT_EQ(file.motion.GetKeyCount(), 4);
    ExpectNear(PosedNode(file.motion, "Head", 3).m_kWorldMatrix,
               Mat4{{0, 1, 0, 0, -1, 0, 0, 0, 0, 0, 1, 0, 3, 13, 0, 1}}, 1e-5);
    EXPECT_EQ(NodeBoneLength(*file.motion.motionRoot), 50.0f);
    EXPECT_EQ(TrackOf(file.motion, "Head").m_kRestMatrix, Mat4Compose(kMat3Identity, {0, 10, 0}));
    EXPECT_FALSE(TKCHBStream().WriteFile(file.folder.Path("b.chb")));
}

// As many frames stay unread at the end as the first one's number says, and the keys begin as many later.
TEST(TKCHBStream, TakesTheBeginFrameTwice)
{
    const std::tuple<int, int, size_t, Vec3, Vec3> rows[] = {
        {0, 9, 10, {0, 0, 0}, {9, 0, 0}}, {2, 9, 4, {4, 0, 0}, {7, 0, 0}}, {3, 9, 1, {6, 0, 0}, {6, 0, 0}},
        {4, 9, 1, {5, 0, 0}, {5, 0, 0}},  {6, 9, 0, {0, 0, 0}, {0, 0, 0}},
    };
    for (const auto& [begin, end, keys, first, last] : rows)
    {
        SCOPED_TRACE(begin);
        CLoadedMotion file(SmallCHB(begin, end), "a.chb");
        ASSERT_TRUE(file.loaded) << RecordText(file.motion.Record());
        const int frameCount = end - begin + 1;
        EXPECT_EQ(file.motion.GetKeyCount(), frameCount);
        EXPECT_EQ(file.motion.GetLastFrame(), static_cast<float>(frameCount) - 1.0f);
        EXPECT_EQ(TrackOf(file.motion, "Torso").m_kPositionKeys.size(), keys);
        EXPECT_EQ(PosedNode(file.motion, "Torso", 0).m_kMatrix.Translation(), first);
        EXPECT_EQ(PosedNode(file.motion, "Torso", frameCount).m_kMatrix.Translation(), last);
    }
}

TEST(TKCHBStream, ReadsOddFilesAsTheyStand)
{
    const std::string plain = SmallCHB(0, 3);
    const size_t parent = kFirstName + size_t{2} * 260 + 11 + size_t{3} * 256; // of the head
    const Patch rows[] = {
        {"a header's keyword in another case", 0, "[header]", "", "Torso(Head)"},
        {"a frame's keyword in another case", kFirstFrame - 5, "fRAME", "", "Torso(Head)"},
        {"an old version", kIntOffsets[0], Bytes(-5), "", "Torso(Head)"},
        {"a name of 255 characters", kFirstName, std::string(255, 'A'), "", "Torso(Head)"},
        {"something odd behind the end", plain.size(), Bytes(kNaN), "", "Torso(Head)"},
        {"an unknown parent", parent, Name("Body"), "UnknownSegment 1646 Body\n", "Torso"},
        {"a parent in small letters", parent, Name("global"), "UnknownSegment 1646 global\n", "Torso"},
        {"two roots", parent, Name("Global"), "", "Torso"},
        {"its own parent", parent, Name("Head"), "", "Torso"},
        {"no frames", kIntOffsets[kEnd], Bytes(-7), "", "Torso(Head)"},
    };
    for (const Patch& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CLoadedMotion file(Patched(plain, row.at, row.bytes), "a.chb");
        EXPECT_TRUE(file.loaded);
        EXPECT_EQ(RecordText(file.motion.Record()), row.record);
        EXPECT_EQ(TreeText(file.motion.motionRoot.Get()), row.text);
    }
    EXPECT_TRUE(CLoadedMotion(SmallCHB(1, 3) + Bytes(kNaN), "a.chb").loaded) << "a frame that is not read";
}

// What is thrown tells the number of a keyword that is not there.
TEST(TKCHBStream, RefusesWithReasonAndByte)
{
    const CTempFolder folder;
    const std::string plain = SmallCHB(0, 3);
    const float infinity = std::numeric_limits<float>::infinity();
    const size_t second = kFirstFrame + kFrameBytes;
    const Patch rows[] = {
        {"another file", 0, "HIERARCHY", "BadHeader 0 [HEADER]", "At Line: 1"},
        {"version 722", kIntOffsets[0], Bytes(722), "BadVersion 25 722"},
        {"a begin before 0", kIntOffsets[kBegin], Bytes(-1), "BadCount 83 EndFrame"},
        {"101 segments", kIntOffsets[kSegments], Bytes(101), "TooLarge 83 NumSegments"},
        {"a segment more", kIntOffsets[kSegments], Bytes(3), "MissingSection 871 [HIERARCHY]", "At Line: 8"},
        {"frames without end", kIntOffsets[kEnd], Bytes(2147483647), "BadCount 83 EndFrame"},
        {"a frame more", kIntOffsets[kEnd], Bytes(4), "Truncated 2074 "},
        {"another keyword", kFirstFrame - 5, "Flame", "MissingSection 1654 Frame", "At Line: 10"},
        {"another number", second, Bytes(2), "MissingSection 1768 Frame 1", "At Line: 11"},
        {"an endless length", kFirstName + 256, Bytes(infinity), "BadNumber 351 "},
        {"an infinity in a matrix", kFirstFrame + 4, Bytes(infinity), "BadNumber 1699 "},
        {"a name without an end", kFirstName, std::string(256, 'A'), "BadName 347 " + std::string(80, 'A')},
    };
    for (const Patch& row : rows)
    {
        SCOPED_TRACE(row.what);
        const std::string bytes = Patched(plain, row.at, row.bytes);
        const CLoadedMotion file(bytes, "a.chb");
        EXPECT_FALSE(file.loaded);
        EXPECT_FALSE(file.motion.motionRoot);
        EXPECT_EQ(RecordText(file.motion.Record()), "failed " + row.record + "\n");
        const std::optional<ERROBJ> error = Thrown(folder, bytes);
        ASSERT_TRUE(error);
        EXPECT_EQ(error->code, 2);
        EXPECT_STREQ(error->what, row.text);
        int line = 0;
        EXPECT_EQ(std::sscanf(error->where, "TKCHBStream Line:%d", &line), 1) << error->where;
    }
    const std::string noRoot = Patched(plain, kFirstName + size_t{2} * 260 + 11 + 256, Name("Head"));
    EXPECT_EQ(RecordText(CLoadedMotion(noRoot, "a.chb").motion.Record()), "failed NoRoot 2074 Global\n");
}

TEST(TKCHBStream, NoBeginningOfAFileIsRead)
{
    const CTempFolder folder;
    const std::string bytes = SmallCHB(0, 1);
    for (size_t end = 0; end < bytes.size(); ++end)
        EXPECT_TRUE(Thrown(folder, bytes.substr(0, end))) << end << " bytes";
    EXPECT_FALSE(Thrown(folder, bytes));
}

// No number in the header is taken at its word before the bytes are there.
TEST(TKCHBStream, SurvivesEveryCount)
{
    const std::string plain = SmallCHB(0, 3);
    for (const size_t at : kIntOffsets)
    {
        for (const int value : {-2147483647 - 1, -1, 0, 1, 3, 99, 1 << 20, 2147483647})
        {
            const CLoadedMotion file(Patched(plain, at, Bytes(value)), "a.chb");
            EXPECT_EQ(file.loaded, static_cast<bool>(file.motion.motionRoot)) << at << " " << value;
            EXPECT_NE(file.loaded, static_cast<bool>(file.motion.Record().Failure())) << at << " " << value;
            EXPECT_TRUE(!file.loaded || IsFinite(*file.motion.motionRoot)) << at << " " << value;
        }
    }
}

} // namespace
} // namespace gw
