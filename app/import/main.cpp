// gaitwright-import [--clip=NAME] [--rate=RATE] FILE: reads a file of a modeling program and writes its
// motion to the standard output, for the reader that started it. The file may be hostile and the library has
// had faults, so the process gives up everything it does not need before it opens the file. It never fails by
// itself: what went wrong is part of the message.

#include "CModelReader.h"
#include "CSceneNodes.h"
#include "ImportedMotion.h"
#include "Sandbox.h"
#include "ScenePoses.h"
#include "SceneSkeleton.h"
#include "Text.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <new>
#include <numbers>
#include <span>
#include <string>
#include <string_view>
#include <unordered_set>

namespace gw {

namespace {

constexpr double kMostKeys = 1 << 25; // 28 bytes each; a body of 65 joints for two hours

struct Order
{
    std::string clip;
    double rate = 0.0;
    std::string path;
};

Order ReadArguments(int count, char** arguments)
{
    constexpr std::string_view kClip = "--clip=";
    constexpr std::string_view kRate = "--rate=";
    Order order;
    for (int i = 1; i < count; ++i)
    {
        const std::string_view argument = arguments[i];
        if (argument.starts_with(kClip))
            order.clip = argument.substr(kClip.size());
        else if (argument.starts_with(kRate))
            order.rate = std::atof(arguments[i] + kRate.size());
        else
            order.path = argument;
    }
    return order;
}

// Returns a name by which this clip, and no earlier one, can be requested. `taken` has the earlier names.
std::string ClipName(const aiAnimation& clip, unsigned index, std::unordered_set<std::string>& taken)
{
    const std::string name = clip.mName.length > 0 ? clip.mName.C_Str() : "clip " + std::to_string(index + 1);
    std::string unique = name;
    for (int number = 2; !taken.insert(LowerCase(unique)).second; ++number)
        unique = name + ' ' + std::to_string(number);
    return unique;
}

// Returns the requested clip, or the longest; null if the file does not have it.
const aiAnimation* ChooseClip(const aiScene& scene, const Order& order, ImportedMotion& motion)
{
    const aiAnimation* chosen = nullptr;
    double longest = -1.0;
    std::unordered_set<std::string> taken;
    for (unsigned i = 0; i < scene.mNumAnimations; ++i)
    {
        const aiAnimation& clip = *scene.mAnimations[i];
        motion.clips.push_back(ClipName(clip, i, taken));
        const double seconds = clip.mDuration / std::max(clip.mTicksPerSecond, 1.0);
        const bool fits =
            order.clip.empty() ? seconds > longest : !chosen && EqualNoCase(motion.clips.back(), order.clip);
        if (!fits)
            continue;
        chosen = &clip;
        longest = seconds;
        motion.clip = motion.clips.back();
    }
    return chosen;
}

template <class T>
T Fact(const aiScene& scene, const char* name, T fallback)
{
    T value = fallback;
    return scene.mMetaData && scene.mMetaData->Get(name, value) ? value : fallback;
}

// A unit of an FBX file is some number of centimeters. The other formats are in meters; the library applies
// the unit of a Collada file itself.
double UnitMeters(const aiScene& scene)
{
    constexpr double kCentimeter = 0.01;
    const bool isFBX = scene.mMetaData && scene.mMetaData->HasKey("UnitScaleFactor");
    return isFBX ? kCentimeter * Fact(scene, "UnitScaleFactor", 1.0f) : 1.0;
}

// The rotation that turns the file's up axis to Y, if the library has not applied it to the root itself.
SceneMatrix Upright(const aiScene& scene, bool& turns)
{
    constexpr double kQuarter = std::numbers::pi / 2;
    const int axis = Fact(scene, "UpAxis", 1);
    const int sign = Fact(scene, "UpAxisSign", 1);
    SceneMatrix matrix;
    turns = scene.mRootNode->mTransformation.IsIdentity() && (axis != 1 || sign < 0);
    if (!turns)
        return matrix;
    if (axis == 2)
        return SceneMatrix::RotationX(sign < 0 ? kQuarter : -kQuarter, matrix);
    if (axis == 0)
        return SceneMatrix::RotationZ(sign < 0 ? -kQuarter : kQuarter, matrix);
    return SceneMatrix::RotationX(2.0 * kQuarter, matrix);
}

void Refuse(ImportedMotion& motion, EImport outcome, std::string words = {})
{
    motion.outcome = outcome;
    motion.words = std::move(words);
}

// The library says by its name which node a channel moves. Returns a name for which that is not enough.
std::string SharedName(const CSceneNodes& nodes, const aiAnimation* clip)
{
    std::unordered_set<std::string_view> names;
    for (unsigned i = 0; clip && i < clip->mNumChannels; ++i)
    {
        const std::string_view name = clip->mChannels[i]->mNodeName.C_Str();
        if (!names.insert(name).second && nodes.IsShared(name))
            return std::string(name);
    }
    return {};
}

// The library copies 16-bit keys as if they were floats. The results are not rotations.
bool HasBadRotation(const aiAnimation* clip)
{
    for (unsigned i = 0; clip && i < clip->mNumChannels; ++i)
    {
        const std::span keys(clip->mChannels[i]->mRotationKeys, clip->mChannels[i]->mNumRotationKeys);
        const bool areGood = std::ranges::all_of(keys, [](const aiQuatKey& key) {
            const aiQuaternion& q = key.mValue;
            const float square = q.w * q.w + q.x * q.x + q.y * q.y + q.z * q.z;
            return square > 0.25f && square < 4.0f;
        });
        if (!areGood)
            return true;
    }
    return false;
}

void ReadScene(const aiScene& scene, const Order& order, ImportedMotion& motion)
{
    const CSceneNodes nodes(scene);
    const SceneSkeleton skeleton = FindSkeleton(nodes);
    const aiAnimation* const animation = ChooseClip(scene, order, motion);
    if (!order.clip.empty() && !animation)
        return Refuse(motion, EImport::NoClip, order.clip);
    if (skeleton.nodes.empty())
        return Refuse(motion, EImport::NoSkeleton);
    if (const std::string name = SharedName(nodes, animation); !name.empty())
        return Refuse(motion, EImport::Refused, "it moves several nodes that are all called " + name);
    if (HasBadRotation(animation))
        return Refuse(motion, EImport::Refused,
                      "its rotations are damaged, or packed in a way that is not supported");
    const SceneClip clip = PlanClip(nodes, animation, order.rate);
    if (!(clip.frames * static_cast<double>(skeleton.nodes.size()) < kMostKeys))
        return Refuse(motion, EImport::TooLarge);
    motion.rate = clip.rate;
    motion.isRateOfFile = clip.isRateOfFile;
    motion.unitMeters = UnitMeters(scene);
    motion.frameCount = static_cast<uint32_t>(clip.frames);
    const SceneMatrix upright = Upright(scene, motion.wasTurnedUp);
    SampleJoints(nodes, skeleton, clip, upright, motion);
}

ImportedMotion Import(const Order& order)
{
    ImportedMotion motion;
    CModelReader reader(order.path);
    if (const aiScene* const scene = reader.Read())
        ReadScene(*scene, order, motion);
    else if (reader.IsOutOfMemory())
        Refuse(motion, EImport::TooLarge);
    else
        Refuse(motion, EImport::Refused, reader.WhyNot());
    return motion;
}

ImportedMotion ImportSafely(const Order& order)
{
    try
    {
        return Import(order);
    } catch (const std::bad_alloc&)
    {
        ImportedMotion motion;
        Refuse(motion, EImport::TooLarge);
        return motion;
    } catch (const std::exception& failure)
    {
        ImportedMotion motion;
        Refuse(motion, EImport::Refused, failure.what());
        return motion;
    }
}

} // namespace

} // namespace gw

int main(int count, char** arguments)
{
    const gw::Order order = gw::ReadArguments(count, arguments);
    if (order.path.empty() || !gw::EnterSandbox())
        return EXIT_FAILURE;
    const auto write = [](std::span<const std::byte> bytes) {
        return std::fwrite(bytes.data(), 1, bytes.size(), stdout) == bytes.size();
    };
    const bool sent = gw::WriteImported(gw::ImportSafely(order), write) && std::fflush(stdout) == 0;
    return sent ? EXIT_SUCCESS : EXIT_FAILURE;
}
