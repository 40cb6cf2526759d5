// The facade: which stream a name chooses and what a failed call leaves.

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "MotionTexts.h"
#include "Paths.h"
#include "Skeleton.h"
#include "TKBVHStream.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>
#include <limits>
#include <sstream>
#include <tuple>

namespace gw {
namespace {

TEST(CMotionFile, ChoosesByTheExtension)
{
    const std::tuple<const char*, std::string_view, const char*> rows[] = {
        {"a.bvh", kSmallBVH, "Hips(Chest)"},
        {"a.BVH", kSmallBVH, "Hips(Chest)"},
        {"a.bvh.htr", kSmallHTR, "Torso(Head)"},
        {".htr", kSmallHTR, "Torso(Head)"},
        {"a.htr.bvh", kSmallHTR, ""},
        {"a.cha", kSmallCHA, "Torso(Head)"},
        {"a.chb", kSmallCHA, ""},
        {"a.txt", kSmallBVH, ""},
        {"bvh", kSmallBVH, ""},
    };
    for (const auto& [name, text, tree] : rows)
    {
        SCOPED_TRACE(name);
        const CLoadedMotion file(text, name);
        EXPECT_EQ(file.loaded, *tree != '\0');
        EXPECT_EQ(TreeText(file.motion.motionRoot.Get()), tree);
        EXPECT_EQ(static_cast<bool>(file.motion.restRoot), file.loaded && text == kSmallHTR);
        EXPECT_NE(file.loaded, static_cast<bool>(file.motion.Record().Failure()));
    }
}

TEST(CMotionFile, EveryPrefixIsTakenOrRefused)
{
    const CTempFolder folder;
    for (const auto& [name, text] :
         {std::pair{"a.bvh", kSmallBVH}, {"a.htr", kSmallHTR}, {"a.cha", kSmallCHA}})
    {
        for (size_t length = 0; length <= text.size(); ++length)
        {
            CMotionFile motion;
            WriteBytes(folder.Path(name), text.substr(0, length));
            const bool loaded = motion.Load(folder.Path(name));
            EXPECT_NE(loaded, static_cast<bool>(motion.Record().Failure())) << length << " bytes of " << name;
            EXPECT_TRUE(!loaded || IsFinite(*motion.motionRoot)) << length << " bytes of " << name;
        }
    }
}

TEST(CMotionFile, EmptyBonesAreAsLongAsDrawnOnes)
{
    for (const auto& [name, text] :
         {std::pair{"a.bvh", kSmallBVH}, {"a.htr", kSmallHTR}, {"a.cha", kSmallCHA}})
    {
        SCOPED_TRACE(name);
        const CLoadedMotion drawn(text, name);
        CMotionFile empty;
        empty.boneMeshes = EBoneMeshes::Empty;
        ASSERT_TRUE(empty.Load(drawn.path));
        const std::vector<CNode*> bones = NodesOf(*drawn.motion.motionRoot);
        const std::vector<CNode*> others = NodesOf(*empty.motionRoot);
        for (size_t i = 0; i < bones.size(); ++i)
        {
            EXPECT_EQ(NodeBoneLength(*bones[i]), NodeBoneLength(*others[i]));
            EXPECT_EQ(NodeBoneEnd(*bones[i]), NodeBoneEnd(*others[i]));
            EXPECT_NE(FindBoneMesh(*bones[i])->XYZBuffer().empty(),
                      FindBoneMesh(*others[i])->XYZBuffer().empty());
        }
    }
}

TEST(CMotionFile, KeepsItsTreesWhenALoadFails)
{
    CLoadedMotion file(kSmallHTR, "a.htr");
    ASSERT_TRUE(file.loaded);
    const Ref<CNode> motion = file.motion.motionRoot;
    const Ref<CNode> rest = file.motion.restRoot;
    WriteBytes(file.folder.Path("bad.htr"), "[Header]\n");
    WriteBytes(file.folder.Path("other.txt"), "no motion");
    const std::tuple<std::string, bool, const char*> rows[] = {
        {"", false, "failed NotFound 0 \n"},
        {file.folder.Path("none.bvh"), false, "failed NotFound 0 \n"},
        {file.folder.Path("bad.htr"), false, "failed MissingSection 1 [SegmentNames&Hierarchy]\n"},
        {file.folder.Path("other.txt"), true, ""},
        {file.folder.Path("none.txt"), true, ""},
    };
    for (const auto& [path, loaded, record] : rows)
    {
        SCOPED_TRACE(path);
        motion->UpdateScene(1.0f, true);
        EXPECT_EQ(file.motion.Load(path), loaded);
        EXPECT_EQ(RecordText(file.motion.Record()), record);
        EXPECT_TRUE(file.motion.motionRoot == motion && file.motion.restRoot == rest);
        const Vec3 first{1, 102, 3};
        EXPECT_EQ(motion->m_kMatrix.Translation() == first, loaded) << "stands at time 0 again";
    }
    WriteBytes(file.folder.Path("good.bvh"), kSmallBVH);
    ASSERT_TRUE(file.motion.Load(file.folder.Path("good.bvh")));
    EXPECT_EQ(TreeText(file.motion.motionRoot.Get()), "Hips(Chest)");
    EXPECT_TRUE(file.motion.restRoot == rest) << "only an HTR brings another rest pose";
}

TEST(CMotionFile, WritesNothingItCannotWriteWhole)
{
    CLoadedMotion htr(kSmallHTR, "a.htr");
    const CLoadedMotion bvh(kSmallBVH, "a.bvh");
    CMotionFile withoutRest(bvh.motion);
    const std::tuple<CMotionFile&, std::string, float, const char*> rows[] = {
        {htr.motion, "b.bvh", 1.0f, "failed UnknownFormat 0 \n"},
        {htr.motion, "b", 1.0f, "failed UnknownFormat 0 \n"},
        {htr.motion, "none/b.htr", 1.0f, "failed WriteError 0 \n"},
        {htr.motion, "b.htr", 1e30f, "failed TooLarge 0 \n"},
        {htr.motion, "b.htr", std::numeric_limits<float>::quiet_NaN(), "failed TooLarge 0 \n"},
        {withoutRest, "b.htr", 1.0f, "failed NoRoot 0 \n"},
    };
    for (const auto& [motion, name, frameScale, record] : rows)
    {
        SCOPED_TRACE(name + record);
        EXPECT_FALSE(motion.Save(htr.folder.Path(name), frameScale));
        EXPECT_EQ(RecordText(motion.Record()), record);
        const std::filesystem::directory_iterator files(htr.folder.Path());
        EXPECT_EQ(std::distance(begin(files), end(files)), 1) << "the file that was read";
    }
    EXPECT_FALSE(htr.motion.Save("", 1.0f));
    EXPECT_EQ(htr.motion.GetKeyCount(), 2) << "the motion is still there";
}

// A chest with two arms of three joints and a thumb, each bone of an arm along one offset.
std::string Arms(const std::string& left, const std::string& right)
{
    const auto arm = [](const std::string& side, const std::string& along, const char* offset) {
        return "JOINT " + side + "Arm\n{\nOFFSET " + offset + "\nJOINT " + side + "ForeArm\n{\nOFFSET " +
               along + "\nJOINT " + side + "Hand\n{\nOFFSET " + along + "\nJOINT " + side +
               "HandThumb\n{\n}\n}\n}\n}\n";
    };
    return "HIERARCHY\nROOT Chest\n{\n" + arm("Left", left, "2 0 9") + arm("Right", right, "-2 0 9") +
           "}\nMOTION\nFrames: 0\nFrame Time: 1\n";
}

TEST(CMotionFile, NamesWhatIsNoTPose)
{
    const std::tuple<const char*, const char*, bool> rows[] = {
        {"5 0 -2", "-5 0 -2", false},
        {"5 0 -5", "-5 0 -5", true},
        {"5 0 0", "0 0 -5", true},
        {"0 0 0", "0 0 0", false},
    };
    for (const auto& [left, right, warns] : rows)
    {
        const CLoadedMotion file(Arms(left, right), "a.bvh");
        EXPECT_EQ(RecordText(file.motion.Record()), warns ? "RestPose 0 LeftArm\n" : "") << left;
    }
}

// Poses that an independent reading gives, of files that are too large for this repository: compares those of
// a motion with those of a text, which has a name or a number on each line.
void ExpectPoses(CMotionFile& motion, const std::string& text)
{
    int frame = 0;
    const float* found = nullptr;
    const CNode* node = nullptr;
    size_t nodeCount = 0;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);)
    {
        char name[100] = {};
        float number = 0.0f;
        if (std::sscanf(line.c_str(), " \"frame\": %d", &frame) == 1)
            continue;
        if (std::sscanf(line.c_str(), " \"name\": \"%99[^\"]", name) == 1)
        {
            node = &PosedNode(motion, name, frame);
            ++nodeCount;
        }
        else if (line.find("\"local\"") != line.npos)
            found = node->m_kMatrix.m;
        else if (line.find("\"world\"") != line.npos)
            found = node->m_kWorldMatrix.m;
        else if (std::sscanf(line.c_str(), " %f", &number) == 1)
        {
            EXPECT_NEAR(*found++, number, 1e-4) << node->GetName();
        }
    }
    EXPECT_EQ(nodeCount, NodesOf(*motion.motionRoot).size());
}

TEST(RealMotions, OfMatricesStandAsAnIndependentReadingHasThemOrAreRefused)
{
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const std::string folder = SharedDataFolder() + "motions/";
    for (const char* extension : {".cha", ".chb"})
    {
        for (const std::string& name : FilesInFolder(folder, extension))
        {
            SCOPED_TRACE(name);
            CMotionFile motion;
            const bool loaded = motion.Load(folder + name);
            EXPECT_EQ(loaded, !name.starts_with("bad-"));
            if (loaded)
                ExpectPoses(motion, ReadBytes(folder + name.substr(0, name.size() - 4) + ".pose.json"));
        }
    }
}

} // namespace
} // namespace gw
