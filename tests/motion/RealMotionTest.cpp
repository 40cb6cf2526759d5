// Real files of many programs, and poses that an independent reading of the formats gives. They are too large
// for this repository: without them there is nothing to check.

#include "MotionTexts.h"
#include "Paths.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TKBVHStream.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr double kDegrees = 0.05;
constexpr double kLength = 0.05;

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

void ExpectSamePoses(CMotionFile& found, CMotionFile& expected)
{
    ASSERT_EQ(TreeText(found.motionRoot.Get()), TreeText(expected.motionRoot.Get()));
    ASSERT_EQ(found.GetKeyCount(), expected.GetKeyCount());
    const std::vector<CNode*> nodes = NodesOf(*found.motionRoot);
    const std::vector<CNode*> others = NodesOf(*expected.motionRoot);
    for (int frame = 0; frame < found.GetKeyCount(); ++frame)
    {
        PosedNode(found, nodes[0]->GetName(), frame);
        PosedNode(expected, others[0]->GetName(), frame);
        for (size_t i = 0; i < nodes.size(); ++i)
        {
            const Mat4& a = nodes[i]->m_kWorldMatrix;
            const Mat4& b = others[i]->m_kWorldMatrix;
            ASSERT_LT(DegreesBetween(NormalizedRows(a), NormalizedRows(b)), kDegrees) << nodes[i]->GetName();
            ASSERT_LT(Vec3Length(a.Translation() - b.Translation()), kLength) << nodes[i]->GetName();
        }
    }
}

TEST(RealMotions, LoadOrAreRefusedForTheirOddity)
{
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

TEST(RealMotions, StandAsAnIndependentReadingHasThem)
{
    const struct
    {
        const char* name;
        int frame;
    } rows[] = {
        {"made-1-mb-tilt-kick",    8  },
        {"made-2-max-wild-kick",   14 },
        {"made-4-cmu-tilt-turn",   30 },
        {"mixamo_freebvh",         35 },
        {"mocapbank_lefthip",      108},
        {"walk01_leftupleg",       26 },
        {"yxz_lefthip",            47 },
        {"cmu_cgspeed_example",    35 },
        {"poser_boxing",           8  },
        {"bandai_walk_normal_002", 13 },
        {"geno_stance",            1  },
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.name);
        const std::string folder = SharedDataFolder() + "golden/" + row.name + "/";
        if (!FileExists(folder + "pose.json"))
            return;
        CMotionFile motion;
        ASSERT_TRUE(motion.Load(folder + "source.bvh"));
        ExpectPoses(motion, row.frame, ReadBytes(folder + "pose.json"), 1e-3);
    }
}

TEST(RealMotions, OfMatricesStandAsAnIndependentReadingHasThem)
{
    const struct
    {
        const char* name;
        const char* extension;
        int frame;
    } rows[] = {
        {"plain-text",   ".cha", 20},
        {"remarks",      ".cha", 18},
        {"short-row",    ".cha", 16},
        {"open-header",  ".cha", 5 },
        {"plain-binary", ".chb", 13},
        {"begin",        ".chb", 6 },
        {"roots",        ".chb", 13},
        {"hundred",      ".chb", 4 },
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.name);
        const std::string path = SharedDataFolder() + "motions/" + row.name;
        if (!FileExists(path + row.extension))
            return;
        CMotionFile motion;
        ASSERT_TRUE(motion.Load(path + row.extension));
        ExpectPoses(motion, row.frame, ReadBytes(path + ".pose.json"), 1e-4);
    }
}

TEST(RealMotions, OfMatricesAreRefusedWhereTheyAreDamaged)
{
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

TEST(RealMotions, AreWrittenAsAnIndependentWriterHasThem)
{
    const struct
    {
        const char* name;
        float frameScale;
    } rows[] = {
        {"made-1-mb-tilt-kick",  1.0f},
        {"made-2-max-wild-kick", 0.5f},
        {"made-4-cmu-tilt-turn", 2.0f},
        {"made-5-mb-exact-walk", 3.3f},
    };
    const CTempFolder out;
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.name);
        const std::string folder = SharedDataFolder() + "golden/" + row.name + "/";
        if (!FileExists(folder + "transcoded.bvh"))
            return;
        CMotionFile source;
        ASSERT_TRUE(source.Load(folder + "source.bvh"));
        ASSERT_TRUE(TKBVHStream(source).WriteFile(out.Path("a.bvh")));
        ASSERT_TRUE(source.Load(folder + "expected.htr"));
        ASSERT_TRUE(source.Save(out.Path("a.htr"), row.frameScale));
        for (const auto& [written, expected] : {
                 std::pair("a.bvh", "transcoded.bvh"), {"a.htr", "rescaled.htr"}
        })
        {
            CMotionFile found;
            CMotionFile wanted;
            ASSERT_TRUE(found.Load(out.Path(written)));
            ASSERT_TRUE(wanted.Load(folder + expected));
            EXPECT_EQ(found.GetFrequency(), wanted.GetFrequency());
            ExpectSamePoses(found, wanted);
        }
    }
}

} // namespace
} // namespace gw
