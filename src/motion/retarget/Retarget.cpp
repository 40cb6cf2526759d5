// The frame loop. Everything that is the same for all frames is prepared before it: the source nodes to
// update (CSourceSampler), the target bones' shares (CPoseMatcher), the bones of the legs (CLegPlanter), and
// the tracks at full length. The loop itself only works on arrays and allocates nothing.

#include "CFaithfulPose.h"
#include "CGeometry.h"
#include "CKeyframeControl.h"
#include "CLegPlanter.h"
#include "CMotionFile.h"
#include "CPoseMatcher.h"
#include "CPoseSampler.h"
#include "CRetargeter.h"
#include "CSourceSampler.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr float kBodyWeight = 0.45f;
// Frame numbers are floats; from here on, adding 1 has no effect.
constexpr float kFrameLimit = 16777216.0f;
// Limits on the size of the result's tracks: at most 2 GB, and at most a fixed allowance plus a multiple of
// the source's keys. A container can claim any end time without a single byte of keys.
constexpr uint64_t kResultBytesLimit = uint64_t{1} << 31;
constexpr uint64_t kAnyResultBytes = uint64_t{32} << 20; // about twenty minutes of the fixed skeleton
constexpr uint64_t kResultBytesPerSourceByte = 4;
constexpr uint64_t kKeyBytes = sizeof(float) + sizeof(Quat) + 2 * sizeof(Vec3);

constexpr size_t kProgressFrames = 64;
constexpr float kUsualFrameSeconds = 1.0f / 30.0f; // used if the source has no valid frame time

// Size of all keys below a node. Key times are not counted, because they can be mere claims too.
uint64_t KeyBytesOf(CNode& root)
{
    std::vector<CObject*> found;
    root.FindObjects(found, nullptr, &CKeyframeControl::ms_kRTTI, true);
    uint64_t bytes = 0;
    for (const CObject* object : found)
    {
        const auto& track = static_cast<const CKeyframeControl&>(*object);
        bytes += track.m_kRotationKeys.size() * sizeof(Quat) +
                 (track.m_kPositionKeys.size() + track.m_kScaleKeys.size()) * sizeof(Vec3);
    }
    return bytes;
}

bool IsInProportion(uint64_t resultBytes, CNode& source)
{
    if (resultBytes <= kAnyResultBytes)
        return true;
    const uint64_t expected = kAnyResultBytes + kResultBytesPerSourceByte * KeyBytesOf(source);
    return resultBytes <= std::min(expected, kResultBytesLimit);
}

void RestPose(CNode& root)
{
    SwitchControls(root, false);
    root.UpdateScene(0.0f, true);
}

// Moves the root vertically until the lowest point of the skeleton's meshes is at y = 0.
void GroundTarget(CNode& root, float time)
{
    root.UpdateScene(time, true);
    float lowest = root.m_kBound.m_kCentre.y;
    std::vector<CObject*> geometries;
    root.FindObjects(geometries, nullptr, &CGeometry::ms_kRTTI, true);
    for (CObject* geometry : geometries)
    {
        for (const Vec3& point : static_cast<CGeometry*>(geometry)->WorldXYZBuffer())
            lowest = std::min(lowest, point.y);
    }
    Vec3 translation = root.m_kMatrix.Translation();
    translation.y -= lowest;
    root.m_kMatrix.SetTranslation(translation);
}

// Computes world matrices from the current local ones, without evaluating the new tracks.
void UpdateWorlds(CNode& root)
{
    for (CNode* node : NodesOf(root))
    {
        const CSpatial* parent = node->GetParent();
        node->m_kWorldMatrix = parent ? node->m_kMatrix * parent->m_kWorldMatrix : node->m_kMatrix;
    }
}

uint64_t FrameCount(float last)
{
    if (!(last >= 0.0f))
        return 0;
    return static_cast<uint64_t>(std::min(std::floor(last), kFrameLimit - 1.0f)) + 1;
}

// Creates a track at full length, with the bone's rest pose in every frame. Frames that the loop does not
// write keep it.
Ref<CKeyframeControl> MakeTrack(const CPoseMatcher::Bone& bone, size_t frameCount)
{
    Ref<CKeyframeControl> track = new CKeyframeControl;
    track->m_kRestMatrix = bone.node->m_kMatrix;
    track->m_bHasRestMatrix = true;
    track->m_kKeyTimes.resize(frameCount);
    for (size_t frame = 0; frame < frameCount; ++frame)
        track->m_kKeyTimes[frame] = static_cast<float>(frame);
    track->m_kScaleKeys.assign(frameCount, bone.scale);
    track->m_kPositionKeys.assign(frameCount, bone.translation);
    track->m_kRotationKeys.assign(frameCount, QuatFromMat3(bone.rotation));
    return track;
}

// The root's path: the scaled motion of the source's hip, summed frame by frame in 64 bits.
class CRootPath
{
public:
    CRootPath(const CNode* sourceHip, const CNode& targetRoot, float scale)
        : m_pkHip(sourceHip), m_fScale(scale), m_kPreviousHip(HipPosition())
    {
        SetBase(targetRoot.m_kWorldMatrix.Translation());
    }
    /// Returns the root's offset from the root position in the current frame.
    Vec3 Advance(bool restart)
    {
        const Vec3 hip = HipPosition();
        const Vec3 delta = hip - m_kPreviousHip;
        m_kPreviousHip = hip;
        if (restart)
            SetBase(kVec3Zero);
        else
        {
            m_afBase[0] += static_cast<double>(m_fScale) * delta.x;
            m_afBase[1] += static_cast<double>(m_fScale) * delta.y;
            m_afBase[2] += static_cast<double>(m_fScale) * delta.z;
        }
        return {static_cast<float>(m_afBase[0]), static_cast<float>(m_afBase[1]),
                static_cast<float>(m_afBase[2])};
    }

private:
    Vec3 HipPosition() const { return m_pkHip ? m_pkHip->m_kWorldMatrix.Translation() : kVec3Zero; }
    void SetBase(const Vec3& base)
    {
        m_afBase[0] = base.x;
        m_afBase[1] = base.y;
        m_afBase[2] = base.z;
    }

    const CNode* m_pkHip;
    float m_fScale;
    Vec3 m_kPreviousHip;
    double m_afBase[3];
};

void WriteKeys(const std::vector<CPoseMatcher::Bone>& bones, const std::vector<CKeyframeControl*>& tracks,
               size_t frame)
{
    for (size_t bone = 0; bone < bones.size(); ++bone)
    {
        if (!bones[bone].posed)
            continue;
        tracks[bone]->m_kRotationKeys[frame] = QuatFromMat3(bones[bone].rotation);
        tracks[bone]->m_kPositionKeys.Set(frame, bones[bone].translation);
    }
}

} // namespace

bool CRetargeter::Retarget(float begin, float last, float phase, float frequency, const Vec3& rootPosition,
                           bool resetOrigin, bool useLegs)
{
    m_kRecord.Clear();
    if (!m_pkSourceRoot || !m_pkTargetRoot)
        return true;
    CNode& source = *m_pkSourceRoot;
    CNode& target = *m_pkTargetRoot;
    RestPose(target);
    RestPose(source);
    for (CNode* node : NodesOf(target))
        node->DetachControls();

    CPoseMatcher matcher(*this, target);
    CFaithfulPose keeper(*this, matcher, m_bFaithful ? &target : nullptr, m_bHoldHands);
    matcher.MatchPose();
    matcher.WriteNodes();
    GroundTarget(target, 0.0f);
    matcher.ReadTranslation(0);

    uint64_t frameCount = FrameCount(last);
    if (!IsInProportion(frameCount * kKeyBytes * matcher.Bones().size(), source))
    {
        m_kRecord.Fail(EFailure::TooLarge);
        frameCount = 0;
    }
    std::vector<CKeyframeControl*> tracks;
    for (const CPoseMatcher::Bone& bone : matcher.Bones())
    {
        const Ref<CKeyframeControl> track = MakeTrack(bone, frameCount);
        track->m_fFrequency = frequency;
        track->m_fBeginTime = begin;
        track->m_fEndTime = last;
        track->m_fPhase = phase;
        bone.node->AttachControl(track.Get());
        tracks.push_back(track.Get());
    }
    const Run run{frequency, rootPosition, resetOrigin, useLegs};
    PoseFrames(matcher, tracks, run, keeper.Legs().empty() ? nullptr : &keeper);

    source.UpdateScene(0.0f, true);
    target.UpdateScene(0.0f, true);
    return true;
}

float CRetargeter::MeasuredScale()
{
    float scale = 1.0f;
    float footRise = 0.0f;
    MeasureBody(scale, footRise, kBodyWeight);
    if (std::isfinite(scale) && scale > 0.0f)
        return scale;
    m_kRecord.Warn(EFailure::BadScale);
    return 1.0f;
}

// One pass over the frames. Faithful legs need a second one, because each frame depends on its neighbors.
void CRetargeter::PoseFrames(CPoseMatcher& matcher, const std::vector<CKeyframeControl*>& tracks,
                             const Run& run, CFaithfulPose* keeper)
{
    UpdateWorlds(*m_pkTargetRoot);
    const Vec3 targetBase = m_pkTargetRoot->m_kWorldMatrix.Translation();
    MatchFrames(matcher, tracks, run, keeper);
    if (!keeper)
        return;
    const double secondsPerFrame = IsFrameTime(run.frequency) ? run.frequency : kUsualFrameSeconds;
    const size_t frameCount = tracks.front()->m_kKeyTimes.size();
    keeper->Plan(tracks, run.rootPosition + (run.resetOrigin ? kVec3Zero : targetBase), secondsPerFrame,
                 run.useLegs);
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        keeper->WriteFrame(frame, tracks);
        ShowProgress(frameCount + frame, 2 * frameCount);
    }
    keeper->PlanHands(tracks, secondsPerFrame);
    for (size_t frame = 0; frame < frameCount; ++frame)
        keeper->WriteHands(frame, tracks);
}

void CRetargeter::MatchFrames(CPoseMatcher& matcher, const std::vector<CKeyframeControl*>& tracks,
                              const Run& run, CFaithfulPose* keeper)
{
    const float scale = MeasuredScale();
    const size_t frameCount = tracks.front()->m_kKeyTimes.size();
    SwitchControls(*m_pkSourceRoot, true);

    CSourceSampler sampler(m_pkSourceRoot, matcher.SourceNodes());
    CRootPath path(SourceOf(m_pkTargetRoot), *m_pkTargetRoot, scale);
    CLegPlanter legs(*this, matcher, *m_pkTargetRoot);
    if (keeper)
    {
        sampler.Add(keeper->SourceJoints());
        legs.LeaveOut(keeper->Legs());
    }
    auto& bones = matcher.Bones();
    bones.front().posed = true; // the root moves even if no source drives it
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        sampler.Sample(static_cast<float>(frame) / run.frequency);
        matcher.MatchPose();
        if (keeper)
            keeper->Append();
        bones.front().translation = run.rootPosition + path.Advance(frame == 0 && run.resetOrigin);
        WriteKeys(bones, tracks, frame);
        if (run.useLegs)
            legs.Plant(frame, scale, tracks);
        ShowProgress(frame, keeper ? 2 * frameCount : frameCount);
    }
}

void CRetargeter::ShowProgress(size_t done, size_t total) const
{
    if (progress_ && done % kProgressFrames == 0)
        progress_(done, total);
}

} // namespace gw
