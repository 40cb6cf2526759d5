// Mirroring does not depend on how the bones' axes lie. For every bone, the rotation from its rest pose to
// its pose, in world space, is reflected and given to the bone of the other side. With row vectors and rest
// rotation R, the pose is W = R D, and the other bone's pose is R' M D M, where M negates x. In the rest pose
// the host skeleton is its own mirror image.

#include "EditMotion.h"

#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "CNode.h"
#include "HostBones.h"
#include "Mat3.h"
#include "Skeleton.h"

#include <algorithm>
#include <string_view>
#include <unordered_map>

namespace gw {

namespace {

using Nodes = std::vector<CNode*>;

CKeyframeControl* TrackOf(CNode& node)
{
    return RecordCast<CKeyframeControl>(node.GetControl());
}

template <class Keys>
void KeepRange(Keys& keys, size_t first, size_t count)
{
    const size_t begin = std::min(first, keys.size());
    const size_t end = std::min(begin + count, keys.size());
    keys = Keys(keys.begin() + static_cast<std::ptrdiff_t>(begin),
                keys.begin() + static_cast<std::ptrdiff_t>(end));
}

void KeepRange(CKeyArray<Vec3>& keys, size_t first, size_t count)
{
    std::vector<Vec3> kept;
    for (size_t i = first; i < std::min(first + count, keys.size()); ++i)
        kept.push_back(keys[i]);
    keys = CKeyArray<Vec3>(std::move(kept));
}

// The keys are at frames 0, 1, 2, ..., so the first times remain.
void KeepFrames(CKeyframeControl& track, size_t first, size_t count)
{
    KeepRange(track.m_kRotationKeys, first, count);
    KeepRange(track.m_kPositionKeys, first, count);
    KeepRange(track.m_kScaleKeys, first, count);
    KeepRange(track.m_kKeyTimes, 0, count);
    track.m_fEndTime = static_cast<float>(track.m_kKeyTimes.size()) - 1.0f;
}

void CancelTravel(CKeyframeControl& rootTrack)
{
    if (rootTrack.m_kPositionKeys.empty())
        return;
    const Vec3 start = rootTrack.m_kPositionKeys.front();
    for (size_t i = 0; i < rootTrack.m_kPositionKeys.size(); ++i)
        rootTrack.m_kPositionKeys.Set(i, {start.x, rootTrack.m_kPositionKeys[i].y, start.z});
}

// Returns M A M, which reflects a rotation.
Mat3 Reflected(const Mat3& rotation)
{
    Mat3 reflected = rotation;
    for (size_t row = 0; row < 3; ++row)
    {
        for (size_t column = 0; column < 3; ++column)
        {
            if ((row == 0) != (column == 0))
                reflected.m[3 * row + column] = -reflected.m[3 * row + column];
        }
    }
    return reflected;
}

std::string_view OtherSide(std::string_view name)
{
    static constexpr const char* HostSide::*const kBones[] = {
        &HostSide::collar, &HostSide::upperArm, &HostSide::forearm, &HostSide::hand, &HostSide::pelvis,
        &HostSide::thigh,  &HostSide::calf,     &HostSide::foot,    &HostSide::toe};
    for (const auto bone : kBones)
    {
        if (name == kLeftBones.*bone)
            return kRightBones.*bone;
        if (name == kRightBones.*bone)
            return kLeftBones.*bone;
    }
    return name;
}

/// The bones, parents first.
struct MirrorBone
{
    CKeyframeControl* track; ///< null if the bone does not move
    size_t parent;           ///< its own index for the root
    size_t other;            ///< the bone of the other side, or itself
    Mat3 rest;               ///< world rotation in the rest pose
    Mat3 restLocal;
};

std::vector<MirrorBone> MirrorBones(const Nodes& nodes, const Nodes& restNodes)
{
    std::unordered_map<const CSpatial*, size_t> indices;
    std::unordered_map<std::string_view, size_t> names;
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        indices[nodes[i]] = i;
        names[nodes[i]->NameView()] = i;
    }
    std::vector<MirrorBone> bones;
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        const auto parent = indices.find(nodes[i]->GetParent());
        const auto other = names.find(OtherSide(nodes[i]->NameView()));
        const auto rest = std::ranges::find(restNodes, nodes[i]->NameView(), &CNode::NameView);
        const Mat3 local = rest == restNodes.end() ? kMat3Identity : NormalizedRows((*rest)->m_kMatrix);
        MirrorBone bone{TrackOf(*nodes[i]), parent == indices.end() ? i : parent->second,
                        other == names.end() ? i : other->second, local, local};
        if (bone.parent != i)
            bone.rest = local * bones[bone.parent].rest;
        bones.push_back(bone);
    }
    return bones;
}

void MirrorFrame(const std::vector<MirrorBone>& bones, size_t frame, std::vector<Mat3>& worlds,
                 std::vector<Mat3>& mirrored)
{
    for (size_t i = 0; i < bones.size(); ++i)
    {
        const CKeyframeControl* track = bones[i].track;
        const bool isKeyed = track && frame < track->m_kRotationKeys.size();
        const Mat3 local = isKeyed ? QuatToMat3(track->m_kRotationKeys[frame]) : bones[i].restLocal;
        worlds[i] = bones[i].parent == i ? local : local * worlds[bones[i].parent];
    }
    for (size_t i = 0; i < bones.size(); ++i)
    {
        const MirrorBone& other = bones[bones[i].other];
        mirrored[i] = bones[i].rest * Reflected(Mat3Transpose(other.rest) * worlds[bones[i].other]);
    }
    for (size_t i = 0; i < bones.size(); ++i)
    {
        CKeyframeControl* const track = bones[i].track;
        if (!track || frame >= track->m_kRotationKeys.size())
            continue;
        track->m_kRotationKeys[frame] = QuatFromMat3(
            bones[i].parent == i ? mirrored[i] : mirrored[i] * Mat3Transpose(mirrored[bones[i].parent]));
    }
}

void Mirror(const Nodes& nodes, const Nodes& restNodes)
{
    const std::vector<MirrorBone> bones = MirrorBones(nodes, restNodes);
    std::vector<Mat3> worlds(bones.size());
    std::vector<Mat3> mirrored(bones.size());
    CKeyframeControl* const root = bones.empty() ? nullptr : bones.front().track;
    if (!root)
        return;
    for (size_t frame = 0; frame < root->m_kRotationKeys.size(); ++frame)
        MirrorFrame(bones, frame, worlds, mirrored);
    for (size_t i = 0; i < root->m_kPositionKeys.size(); ++i)
    {
        const Vec3 position = root->m_kPositionKeys[i];
        root->m_kPositionKeys.Set(i, {-position.x, position.y, position.z});
    }
}

} // namespace

void SetFrameTime(CNode& root, float seconds)
{
    std::vector<CObject*> tracks;
    root.FindObjects(tracks, nullptr, &CKeyframeControl::ms_kRTTI, true);
    for (CObject* track : tracks)
        static_cast<CKeyframeControl*>(track)->m_fFrequency = seconds;
}

CEditedMotion::CEditedMotion(const CMotionFile& motion, const MotionEdits& edits)
{
    if (!edits.IsAny() || !motion.motionRoot)
        return;
    const Nodes nodes = NodesOf(*motion.motionRoot);
    for (CNode* node : nodes)
    {
        if (CKeyframeControl* const track = TrackOf(*node))
            m_kTracks.push_back({track, track->m_kRotationKeys, track->m_kPositionKeys, track->m_kScaleKeys,
                                 track->m_kKeyTimes, track->m_fEndTime});
    }
    const auto first = static_cast<size_t>(edits.firstFrame);
    const size_t count =
        edits.lastFrame == INT64_MAX ? SIZE_MAX - first : static_cast<size_t>(edits.lastFrame) + 1 - first;
    for (const Track& track : m_kTracks)
        KeepFrames(*track.control, first, count);
    CKeyframeControl* const rootTrack = TrackOf(*nodes.front());
    if (edits.inPlace && rootTrack)
        CancelTravel(*rootTrack);
    if (edits.mirror)
        Mirror(nodes, motion.restRoot ? NodesOf(*motion.restRoot) : Nodes());
}

CEditedMotion::~CEditedMotion()
{
    for (Track& track : m_kTracks)
    {
        track.control->m_kRotationKeys = std::move(track.rotations);
        track.control->m_kPositionKeys = std::move(track.positions);
        track.control->m_kScaleKeys = std::move(track.scales);
        track.control->m_kKeyTimes = std::move(track.times);
        track.control->m_fEndTime = track.endTime;
    }
}

} // namespace gw
