// Motions that come through the import program, compared with what the library says about the same files, and
// with motions that were written as glTF.

#include "CMotionFile.h"
#include "CMotionSampler.h"
#include "GlbFile.h"
#include "Skeleton.h"
#include "TempFolder.h"

#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <map>
#include <string>
#include <vector>

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

} // namespace

// Without helpers for pivots, the library's nodes are the joints.
TEST(Import, JointsAreWhereTheLibraryPutsThem)
{
    const std::string folder = SharedDataFolder();
    if (folder.empty())
        GTEST_SKIP() << "needs models";
    for (const auto& entry : std::filesystem::directory_iterator(folder + "models"))
    {
        const std::string path = entry.path().string();
        if (entry.path().extension() == ".md")
            continue;
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

TEST(Import, AWrittenMotionComesBack)
{
    const CTempFolder folder;
    CMotionFile motion;
    ASSERT_TRUE(motion.Load(WALK_FILE));
    CFailureRecord record;
    ASSERT_TRUE(SaveGlb(motion, 0.01, folder.Path("walk.glb"), record));
    CMotionFile copy;
    ASSERT_TRUE(copy.Load(folder.Path("walk.glb")));
    EXPECT_EQ(copy.GetKeyCount(), motion.GetKeyCount());
    EXPECT_NEAR(copy.GetFrequency(), motion.GetFrequency(), 1e-5);
    EXPECT_EQ(copy.imported.unitMeters, 1.0);
    for (const int frame : {0, 7, motion.GetKeyCount() - 1})
    {
        const Places expected = PlacesOf(motion, frame);
        const Places places = PlacesOf(copy, frame);
        ASSERT_EQ(places.size(), expected.size());
        for (const auto& [name, place] : places)
            EXPECT_LT(Vec3Length(place * 100.0f - expected.at(name)), 1e-4f * HeightOf(expected)) << name;
    }
}

} // namespace gw
