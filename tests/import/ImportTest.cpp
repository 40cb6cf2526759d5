// Motions that come through the import program, compared with what the library says about the same files, and
// with motions that were written as glTF.

#include "CMotionFile.h"
#include "CMotionSampler.h"
#include "Directions.h"
#include "GlbFile.h"
#include "Rotations.h"
#include "Sandbox.h"
#include "Skeleton.h"
#include "TKImportStream.h"
#include "TempFolder.h"

#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <string>
#include <vector>

#include <fcntl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

using Places = std::map<std::string, Vec3>;

// World positions in a frame, by name.
Places PlacesOf(CMotionFile& motion, int frame)
{
    motion.motionRoot->UpdateScene(TimeOfFrame(frame, motion.GetFrequency()), true);
    Places places;
    for (const CNode* node : NodesOf(*motion.motionRoot))
        places[std::string(node->NameView())] = node->m_kWorldMatrix.Translation();
    return places;
}

template <class Key>
auto ValueAt(const Key* keys, unsigned count, double ticks)
{
    unsigned after = 0;
    while (after < count && keys[after].mTime <= ticks)
        ++after;
    if (after == 0 || after == count)
        return keys[after == 0 ? 0 : count - 1].mValue;
    const Key& a = keys[after - 1];
    const Key& b = keys[after];
    decltype(Key::mValue) value;
    Assimp::Interpolator<Key>()(value, a, b, static_cast<ai_real>((ticks - a.mTime) / (b.mTime - a.mTime)));
    return value;
}

void AddPlaces(const aiNode& node, const aiMatrix4x4& parent, const aiAnimation& clip, double ticks,
               Places& places)
{
    aiMatrix4x4 local = node.mTransformation;
    for (unsigned i = 0; i < clip.mNumChannels; ++i)
    {
        const aiNodeAnim& channel = *clip.mChannels[i];
        if (channel.mNodeName != node.mName)
            continue;
        local = aiMatrix4x4(ValueAt(channel.mScalingKeys, channel.mNumScalingKeys, ticks),
                            ValueAt(channel.mRotationKeys, channel.mNumRotationKeys, ticks),
                            ValueAt(channel.mPositionKeys, channel.mNumPositionKeys, ticks));
    }
    const aiMatrix4x4 world = parent * local;
    places[node.mName.C_Str()] = {world.a4, world.b4, world.c4};
    for (unsigned i = 0; i < node.mNumChildren; ++i)
        AddPlaces(*node.mChildren[i], world, clip, ticks, places);
}

float HeightOf(const Places& places)
{
    const auto isLower = [](const auto& a, const auto& b) { return a.second.y < b.second.y; };
    const auto [low, high] = std::ranges::minmax_element(places, isLower);
    return high->second.y - low->second.y;
}

struct CStopped
{
};

} // namespace

// Models of others, and one of our own, which needs no data.
std::vector<std::string> ModelPaths(const CTempFolder& folder)
{
    std::vector<std::string> paths{folder.Path("walk.glb")};
    CMotionFile walk;
    CFailureRecord record;
    EXPECT_TRUE(walk.Load(WALK_FILE) && SaveGlb(walk, 0.01, paths.front(), record));
    const std::string data = SharedDataFolder();
    for (const auto& entry : data.empty() ? std::filesystem::directory_iterator()
                                          : std::filesystem::directory_iterator(data + "models"))
    {
        if (IsImported(entry.path().string()))
            paths.push_back(entry.path().string());
    }
    return paths;
}

// Without helpers for pivots, the library's nodes are the joints.
TEST(Import, JointsAreWhereTheLibraryPutsThem)
{
    const CTempFolder folder;
    for (const std::string& path : ModelPaths(folder))
    {
        SCOPED_TRACE(path);
        Assimp::Importer importer;
        importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
        const aiScene* const scene = importer.ReadFile(path, 0);
        ASSERT_TRUE(scene && scene->mNumAnimations == 1);
        const aiAnimation& clip = *scene->mAnimations[0];
        CMotionFile motion;
        ASSERT_TRUE(motion.Load(path));
        for (int frame = 0; frame <= static_cast<int>(motion.GetLastFrame()); frame += 10)
        {
            Places expected;
            const double ticks = frame * static_cast<double>(motion.GetFrequency()) * clip.mTicksPerSecond;
            AddPlaces(*scene->mRootNode, {}, clip, ticks, expected);
            const Places places = PlacesOf(motion, frame);
            for (const auto& [name, place] : places)
                EXPECT_LT(Vec3Length(place - expected.at(name)), 1e-4f * HeightOf(places))
                    << name << ' ' << frame;
        }
    }
}

// In a process of its own, which keeps the limits.
TEST(Import, TheSandboxChangesNothingOutside)
{
    const CTempFolder folder;
    const std::string path = folder.Path("kept");
    std::ofstream(path) << "kept";
    const auto isShut = [&] {
        const bool canRead = EnterSandbox() && open(path.c_str(), O_RDONLY) >= 0;
        const int forbidden[] = {open(path.c_str(), O_WRONLY),
                                 open(path.c_str(), O_RDONLY | O_TRUNC),
                                 open(folder.Path("new").c_str(), O_RDONLY | O_CREAT, 0600),
                                 mkdir(folder.Path("folder").c_str(), 0700),
                                 unlink(path.c_str()),
                                 rename(path.c_str(), folder.Path("new").c_str()),
                                 socket(AF_INET, SOCK_STREAM, 0),
                                 static_cast<int>(fork())};
        return canRead && std::ranges::all_of(forbidden, [](int result) { return result < 0; });
    };
    EXPECT_EXIT(_exit(isShut() ? 0 : 1), testing::ExitedWithCode(0), "");
    EXPECT_EQ(std::filesystem::file_size(path), 4u);
}

// Another up axis than Y is turned, and rotations are relative to the turned rest pose.
TEST(Import, AWrittenMotionComesBack)
{
    const CTempFolder folder;
    CMotionFile motion;
    ASSERT_TRUE(motion.Load(WALK_FILE));
    for (const Vec3& up : {kVec3UnitY, kVec3UnitZ})
    {
        SCOPED_TRACE(AxisName(up));
        const Mat3 upright = LeastSwing(up, kVec3UnitY);
        CFailureRecord record;
        ASSERT_TRUE(SaveGlb(motion, 0.01, folder.Path("walk.glb"), record, up));
        CMotionFile copy;
        ASSERT_TRUE(copy.Load(folder.Path("walk.glb")));
        EXPECT_EQ(copy.GetKeyCount(), motion.GetKeyCount());
        EXPECT_NEAR(copy.GetFrequency(), motion.GetFrequency(), 1e-5);
        EXPECT_EQ(copy.imported.unitMeters, 1.0);
        const Ref<CNode> root = copy.motionRoot;
        copy.SetProgress([](size_t, size_t) { throw CStopped(); });
        EXPECT_THROW(copy.Load(folder.Path("walk.glb")), CStopped);
        EXPECT_EQ(copy.motionRoot, root) << "a canceled import changes nothing";
        const std::vector<CNode*> joints = NodesOf(*motion.motionRoot);
        const std::vector<CNode*> copies = NodesOf(*copy.motionRoot);
        ASSERT_EQ(copies.size(), joints.size());
        for (int frame = 0; frame < motion.GetKeyCount(); ++frame)
        {
            const float height = HeightOf(PlacesOf(motion, frame));
            PlacesOf(copy, frame);
            for (size_t i = 0; i < joints.size(); ++i)
            {
                const Mat4& world = joints[i]->m_kWorldMatrix;
                const Mat4& again = copies[i]->m_kWorldMatrix;
                const Vec3 place = Turned(world.Translation(), upright);
                EXPECT_LT(Vec3Length(again.Translation() * 100.0f - place), 1e-4f * height);
                const Mat3 rotation = Mat3Transpose(upright) * NormalizedRows(world) * upright;
                EXPECT_LT(DegreesBetween(NormalizedRows(again), rotation), 0.01) << joints[i]->NameView();
            }
        }
    }
}

} // namespace gw
