// Real files of many programs, and poses that an independent reading of the formats gives. They are too large
// for this repository: without them there is nothing to check.

#include "MotionTexts.h"
#include "Paths.h"
#include "Skeleton.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

// A matrix of sixteen numbers behind a word, from a position on that moves behind it.
Mat4 MatrixBehind(const std::string& text, const char* word, size_t& at)
{
    Mat4 matrix;
    at = text.find('[', text.find(word, at)) + 1;
    for (float& element : matrix.m)
    {
        char* end = nullptr;
        element = std::strtof(&text[at], &end);
        at = static_cast<size_t>(end - text.data()) + 1;
    }
    return matrix;
}

std::string NameBehind(const std::string& text, size_t& at)
{
    constexpr std::string_view kName = "\"name\": \"";
    at = std::min(text.find(kName, at), text.size() - kName.size()) + kName.size();
    return text.substr(at, text.find('"', at) - at);
}

void ExpectNear(const Mat4& found, const Mat4& expected, double tolerance)
{
    for (int i = 0; i < 16; ++i)
        EXPECT_NEAR(found.m[i], expected.m[i], tolerance) << i;
}

// The poses of a motion at a frame, against those of a text.
void ExpectPoses(CMotionFile& motion, int frame, const std::string& text, double tolerance)
{
    size_t at = 0;
    for (size_t i = NodesOf(*motion.motionRoot).size(); i > 0; --i)
    {
        const std::string name = NameBehind(text, at);
        const CNode& node = PosedNode(motion, name.c_str(), frame);
        SCOPED_TRACE(name);
        ExpectNear(node.m_kMatrix, MatrixBehind(text, "local", at), tolerance);
        ExpectNear(node.m_kWorldMatrix, MatrixBehind(text, "world", at), tolerance);
    }
    EXPECT_EQ(text.find("\"name\"", at), text.npos) << "all nodes are there";
}

TEST(RealMotions, LoadOrAreRefusedForTheirOddity)
{
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const std::string folder = SharedDataFolder() + "bvh/";
    for (const std::string& name : FilesInFolder(folder, ".bvh"))
    {
        SCOPED_TRACE(name);
        CMotionFile motion;
        const bool loaded = motion.Load(folder + name);
        EXPECT_EQ(loaded, name != "neuron_milad.bvh");
        if (!loaded)
            EXPECT_EQ(RecordText(motion.Record()), "failed BlankLine 350 Frames:\n");
        else
            EXPECT_TRUE(IsFinite(*motion.motionRoot));
    }
}

TEST(RealMotions, OfMatricesStandAsAnIndependentReadingHasThem)
{
    const std::tuple<const char*, const char*, int> rows[] = {
        {"plain-text", ".cha", 20}, {"remarks", ".cha", 18},      {"short-row", ".cha", 16},
        {"open-header", ".cha", 5}, {"plain-binary", ".chb", 13}, {"begin", ".chb", 6},
        {"roots", ".chb", 13},      {"hundred", ".chb", 4},
    };
    for (const auto& [name, extension, frame] : rows)
    {
        SCOPED_TRACE(name);
        const std::string path = SharedDataFolder() + "motions/" + name;
        if (!FileExists(path + extension))
            GTEST_SKIP() << "no shared data here";
        CMotionFile motion;
        ASSERT_TRUE(motion.Load(path + extension));
        ExpectPoses(motion, frame, ReadBytes(path + ".pose.json"), 1e-4);
    }
}

TEST(RealMotions, OfMatricesAreRefusedWhereTheyAreDamaged)
{
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const std::string folder = SharedDataFolder() + "motions/";
    for (const char* extension : {".cha", ".chb"})
    {
        for (const std::string& name : FilesInFolder(folder, extension))
        {
            CMotionFile motion;
            EXPECT_EQ(motion.Load(folder + name), !name.starts_with("bad-")) << name;
        }
    }
}

} // namespace
} // namespace gw
