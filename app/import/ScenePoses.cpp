// A joint's keys are computed from world matrices. That folds everything above and between the joints into
// the keys, whatever it is: helpers of pivots, the armature's scale, the turn to another up axis. Of each
// matrix, the position and the nearest rotation are kept, and the rotation is expressed relative to the rest
// pose.

#include "ScenePoses.h"

#include "CNodeTracks.h"
#include "ImportedMotion.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace gw {

namespace {

using Vector = aiVector3t<double>;
using Rotation = aiMatrix3x3t<double>;

constexpr double kDefaultRate = 30.0;
constexpr double kNoise = 1e-5; // of the longest bone: what single precision in the file amounts to

struct Placement
{
    Rotation rotation;
    Vector position;
};

Vector PositionOf(const SceneMatrix& m)
{
    return {m.a4, m.b4, m.c4};
}

// Orthonormal axes, from the matrix's columns. Scale, shear and mirroring are dropped.
Rotation RotationOf(const SceneMatrix& m)
{
    Vector x(m.a1, m.b1, m.c1);
    Vector y(m.a2, m.b2, m.c2);
    if (!(x.SquareLength() > 0.0) || !((x ^ y).SquareLength() > 0.0))
        return {};
    x.Normalize();
    y = (y - x * (x * y)).Normalize();
    const Vector z = x ^ y;
    return {x.x, y.x, z.x, x.y, y.y, z.y, x.z, y.z, z.z};
}

Placement PlacementOf(const SceneMatrix& m)
{
    return {RotationOf(m), PositionOf(m)};
}

Rotation Transposed(Rotation m)
{
    return m.Transpose();
}

Vec3 Narrow(const Vector& v)
{
    return {static_cast<float>(v.x), static_cast<float>(v.y), static_cast<float>(v.z)};
}

Quat Narrow(const Rotation& m)
{
    const aiQuaterniont<double> q(m);
    return {static_cast<float>(q.w), static_cast<float>(q.x), static_cast<float>(q.y),
            static_cast<float>(q.z)};
}

// A bone as a skin has it: the node, the node of the mesh, and the matrix from the mesh to the bone.
struct Binding
{
    size_t bone;
    size_t mesh;
    SceneMatrix inverseOffset;
};

// The first binding of each bone.
std::vector<Binding> BindingsOf(const CSceneNodes& nodes)
{
    std::vector<Binding> bindings;
    std::vector<bool> isBound(nodes.Count());
    for (size_t i = 0; i < nodes.Count(); ++i)
    {
        for (unsigned m = 0; m < nodes[i].node->mNumMeshes; ++m)
        {
            const aiMesh& mesh = *nodes.Scene().mMeshes[nodes[i].node->mMeshes[m]];
            for (unsigned b = 0; b < mesh.mNumBones; ++b)
            {
                const size_t bone = nodes.Find(mesh.mBones[b]->mName.C_Str());
                SceneMatrix inverse(mesh.mBones[b]->mOffsetMatrix);
                if (bone == CSceneNodes::kNone || isBound[bone] || inverse.Determinant() == 0.0)
                    continue;
                isBound[bone] = true;
                bindings.push_back({bone, i, inverse.Inverse()});
            }
        }
    }
    return bindings;
}

double Distance(const std::vector<Binding>& bindings, const std::vector<SceneMatrix>& worlds, bool inMesh)
{
    double sum = 0.0;
    for (const Binding& binding : bindings)
    {
        const SceneMatrix bound =
            inMesh ? worlds[binding.mesh] * binding.inverseOffset : binding.inverseOffset;
        sum += (PositionOf(bound) - PositionOf(worlds[binding.bone])).Length();
    }
    return sum;
}

// Most files of one clip have keys at whole frames. Returns the longest step that all times are multiples of,
// if there is a usual one; otherwise 0.
double RateOfKeys(const aiAnimation& clip, double ticksPerSecond)
{
    constexpr std::array kUsualRates = {24.0, 25.0, 30.0, 48.0, 50.0, 60.0, 90.0, 100.0, 120.0, 200.0, 240.0};
    constexpr double kTolerance = 0.02; // of a frame
    for (const double rate : kUsualRates)
    {
        bool fits = true;
        bool hasSteps = false;
        for (unsigned c = 0; c < clip.mNumChannels && fits; ++c)
        {
            const aiNodeAnim& channel = *clip.mChannels[c];
            hasSteps = hasSteps || channel.mNumRotationKeys > 2;
            for (unsigned k = 0; k < channel.mNumRotationKeys && fits; ++k)
            {
                const double frame = channel.mRotationKeys[k].mTime / ticksPerSecond * rate;
                fits = std::fabs(frame - std::round(frame)) < kTolerance;
            }
        }
        if (fits && hasSteps)
            return rate;
    }
    return 0.0;
}

double LastKey(const aiAnimation& clip)
{
    double last = 0.0;
    for (unsigned c = 0; c < clip.mNumChannels; ++c)
    {
        const aiNodeAnim& channel = *clip.mChannels[c];
        if (channel.mNumPositionKeys > 0)
            last = std::max(last, channel.mPositionKeys[channel.mNumPositionKeys - 1].mTime);
        if (channel.mNumRotationKeys > 0)
            last = std::max(last, channel.mRotationKeys[channel.mNumRotationKeys - 1].mTime);
    }
    return last;
}

double TicksPerSecond(const aiAnimation& clip)
{
    return clip.mTicksPerSecond > 0.0 ? clip.mTicksPerSecond : kDefaultRate;
}

// A file with a timeline contains its rate, and the library counts in frames; others count milliseconds or
// seconds.
double RateOfFile(const CSceneNodes& nodes, const aiAnimation& clip)
{
    const aiMetadata* const facts = nodes.Scene().mMetaData;
    if (facts && facts->HasKey("FrameRate"))
        return TicksPerSecond(clip);
    return RateOfKeys(clip, TicksPerSecond(clip));
}

// Noise in a bone that is parallel to an axis would decide where its mesh points.
Vec3 WithoutNoise(const Vec3& v, double longest)
{
    const auto settled = [=](float x) { return std::fabs(x) <= kNoise * longest ? 0.0f : x; };
    return {settled(v.x), settled(v.y), settled(v.z)};
}

// Joints that only rotate keep exactly their offsets.
void SettleOffsets(ImportedMotion& motion)
{
    double longest = 0.0;
    for (size_t i = 1; i < motion.joints.size(); ++i)
        longest = std::max(longest, Vec3Length(motion.joints[i].offset));
    for (size_t i = 1; i < motion.joints.size(); ++i)
    {
        ImportedJoint& joint = motion.joints[i];
        joint.offset = WithoutNoise(joint.offset, longest);
        const auto isSettled = [&](const Vec3& p) {
            return Vec3Length(p - joint.offset) <= 2.0 * kNoise * longest;
        };
        if (std::ranges::all_of(joint.positions, isSettled))
            std::ranges::fill(joint.positions, joint.offset);
    }
}

// Returns the world matrices of all nodes in the rest pose: where the skins were bound to their bones, and
// elsewhere as the nodes are placed in the file. At the moment of binding, a skin is in place: a bone's
// matrix is that of its mesh times the inverse of the bone's offset. But glTF ignores the mesh's own matrix,
// and files differ in whether they mean it. The reading that is closer to the nodes' places is the right one.
std::vector<SceneMatrix> RestWorlds(const CSceneNodes& nodes)
{
    std::vector<SceneMatrix> locals = nodes.DefaultLocals();
    const std::vector<SceneMatrix> worlds = nodes.WorldOf(locals);
    const std::vector<Binding> bindings = BindingsOf(nodes);
    const bool inMesh = Distance(bindings, worlds, true) <= Distance(bindings, worlds, false);
    std::vector<SceneMatrix> rest(worlds);
    std::vector<bool> isBound(nodes.Count());
    for (const Binding& binding : bindings)
    {
        isBound[binding.bone] = true;
        rest[binding.bone] = inMesh ? worlds[binding.mesh] * binding.inverseOffset : binding.inverseOffset;
    }
    for (size_t i = 0; i < rest.size(); ++i)
    {
        if (!isBound[i] && nodes[i].parent != CSceneNodes::kNone)
            rest[i] = rest[nodes[i].parent] * locals[i];
    }
    return rest;
}

// Adds the skeleton's joints without keys, and returns where they are at rest.
std::vector<Placement> AddJoints(const CSceneNodes& nodes, const SceneSkeleton& skeleton,
                                 const SceneMatrix& upright, ImportedMotion& motion)
{
    const std::vector<SceneMatrix> worlds = RestWorlds(nodes);
    std::vector<Placement> rest;
    for (size_t j = 0; j < skeleton.nodes.size(); ++j)
    {
        rest.push_back(PlacementOf(upright * worlds[skeleton.nodes[j]]));
        const int parent = skeleton.parents[j];
        const Vector from = parent < 0 ? Vector() : rest[static_cast<size_t>(parent)].position;
        ImportedJoint& joint = motion.joints.emplace_back();
        joint.name = nodes[skeleton.nodes[j]].name;
        joint.parent = parent;
        joint.offset = Narrow(rest[j].position - from);
        joint.positions.reserve(motion.frameCount);
        joint.rotations.reserve(motion.frameCount);
    }
    return rest;
}

// Adds a key to each joint. A joint's own rotation is relative to its rest pose.
void AddKeys(const std::vector<Placement>& places, ImportedMotion& motion)
{
    for (size_t j = 0; j < places.size(); ++j)
    {
        ImportedJoint& joint = motion.joints[j];
        const Placement above = joint.parent < 0 ? Placement() : places[static_cast<size_t>(joint.parent)];
        const Rotation toParent = Transposed(above.rotation);
        joint.positions.push_back(Narrow(toParent * (places[j].position - above.position)));
        joint.rotations.push_back(Narrow(toParent * places[j].rotation));
    }
}

} // namespace

SceneClip PlanClip(const CSceneNodes& nodes, const aiAnimation* animation, double rate)
{
    SceneClip clip{animation, rate > 0.0 ? rate : kDefaultRate};
    if (!animation)
        return clip;
    const double ofFile = RateOfFile(nodes, *animation);
    clip.isRateOfFile = ofFile > 0.0;
    if (clip.isRateOfFile)
        clip.rate = ofFile;
    constexpr double kAlmost = 0.02; // a last key so little before a frame belongs to it
    clip.frames = std::floor(LastKey(*animation) / TicksPerSecond(*animation) * clip.rate + kAlmost) + 1.0;
    return clip;
}

void SampleJoints(const CSceneNodes& nodes, const SceneSkeleton& skeleton, const SceneClip& clip,
                  const SceneMatrix& upright, ImportedMotion& motion)
{
    const CNodeTracks tracks(nodes, clip.animation);
    std::vector<Rotation> fromRest;
    for (const Placement& rest : AddJoints(nodes, skeleton, upright, motion))
        fromRest.push_back(Transposed(rest.rotation));
    const double ticksPerFrame = clip.animation ? TicksPerSecond(*clip.animation) / clip.rate : 0.0;
    std::vector<SceneMatrix> worlds;
    std::vector<Placement> places(fromRest.size());
    for (uint32_t frame = 0; frame < motion.frameCount; ++frame)
    {
        tracks.PoseAt(frame * ticksPerFrame, worlds);
        for (size_t j = 0; j < places.size(); ++j)
        {
            places[j] = PlacementOf(upright * worlds[skeleton.nodes[j]]);
            places[j].rotation = places[j].rotation * fromRest[j];
        }
        AddKeys(places, motion);
    }
    SettleOffsets(motion);
}

} // namespace gw
