#include "CFaithfulPose.h"

#include "CKeyframeControl.h"
#include "Directions.h"
#include "HostBones.h"
#include "JointSteps.h"
#include "Skeleton.h"

#include <cmath>

namespace gw {

namespace {

// A straight leg's knee is kept this far on its own side, in millimetres; a bent one's stands ten times
// farther off the line from hip to ankle.
constexpr float kForwardHint = 10.0f;

std::vector<LegJoints> TargetLegs(CNode* root)
{
    std::vector<LegJoints> legs;
    for (const HostSide& side : kHostSides)
    {
        CNode* const ankle = FindNode(root, side.foot);
        if (ankle && ankle->GetParentNode())
            legs.push_back(
                {FindNode(root, side.thigh), ankle->GetParentNode(), ankle, JointBelow(*ankle, nullptr)});
    }
    return legs;
}

std::vector<CFaithfulLeg> PlanLegs(const CRetargeter& retargeter, const CPoseMatcher& matcher, CNode* root)
{
    const std::vector<LegJoints> joints = TargetLegs(root);
    const double floor = RestFloor(joints);
    std::vector<CFaithfulLeg> legs;
    for (const LegJoints& leg : joints)
    {
        if (auto planned = CFaithfulLeg::Plan(retargeter, matcher, leg, floor))
            legs.push_back(std::move(*planned));
    }
    return legs;
}

std::vector<LegJoints> SourcesOf(const std::vector<CFaithfulLeg>& legs)
{
    std::vector<LegJoints> sources;
    for (const CFaithfulLeg& leg : legs)
        sources.push_back(leg.Source());
    return sources;
}

bool IsFinite(const Vec3& v)
{
    return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

// LeastSwing of unit directions, with an axis that is rounded as results have always had it.
Mat3 SwingBetween(const Vec3& from, const Vec3& to)
{
    const Vec3 across = Vec3Cross(from, to);
    const double sine = Vec3Length(across);
    if (sine == 0.0)
        return LeastSwing(from, to);
    return Mat3FromAxisAngle(across * static_cast<float>(1.0 / sine),
                             static_cast<float>(std::atan2(sine, Vec3Dot(from, to))));
}

// A bone's world rotation, turned the least way so that its joint below lies in a direction.
Mat3 PointedTo(const Vec3& direction, const Mat3& bone, const Vec3& jointBelow)
{
    return bone * SwingBetween(Vec3Normalized(Turned(jointBelow, bone)), Vec3Normalized(direction));
}

} // namespace

CFaithfulPose::CFaithfulPose(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot)
    : matcher_(matcher), m_kLegs(PlanLegs(retargeter, matcher, targetRoot)),
      m_kSource(retargeter.SourceOf(targetRoot), SourcesOf(m_kLegs)), m_kSolver(m_kLegs.size())
{
    for (size_t k = 0; k < m_kLegs.size(); ++k)
    {
        const LegLengths& leg = m_kLegs[k].Lengths();
        m_kSolver.SetLimb(k, {0.0f, static_cast<float>(leg.upper), 0.0f},
                          {0.0f, static_cast<float>(leg.lower), 0.0f}, kVec3UnitZ, kVec3UnitX);
    }
}

void CFaithfulPose::Append()
{
    m_kSource.Append();
    for (CFaithfulLeg& leg : m_kLegs)
        leg.AppendSource();
}

// Brings the bones of the legs to the matched pose of a frame, with the root at the origin: far from it a
// world position has no room for a sole.
void CFaithfulPose::PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    for (const CFaithfulLeg& leg : m_kLegs)
    {
        for (const size_t index : leg.Path())
        {
            CPoseMatcher::Bone& bone = matcher_.Bones()[index];
            bone.rotation = QuatToMat3(tracks[index]->m_kRotationKeys[frame]);
            bone.translation = bone.parent < 0 ? kVec3Zero : tracks[index]->m_kPositionKeys[frame];
            matcher_.UpdateWorld(index);
        }
    }
}

void CFaithfulPose::Plan(const std::vector<CKeyframeControl*>& tracks, const Vec3& origin,
                         double secondsPerFrame, bool holdFeet)
{
    for (size_t frame = 0; frame < m_kSource.FrameCount(); ++frame)
    {
        PoseFrame(frame, tracks);
        for (CFaithfulLeg& leg : m_kLegs)
            leg.ReadTarget(matcher_, frame);
    }
    plan_.emplace(m_kLegs, m_kSource, origin, secondsPerFrame, holdFeet);
}

void CFaithfulPose::WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    PoseFrame(frame, tracks);
    if (IsFinite(plan_->Root(frame)))
        tracks.front()->m_kPositionKeys.Set(frame, plan_->Root(frame));
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
        WriteLeg(leg, frame, tracks);
}

// The knee's place from the hip, in the plane of the source's. False where the ankle cannot be reached.
bool CFaithfulPose::SolveKnee(size_t k, size_t frame, const Vec3& ankle, Vec3& knee)
{
    const CFaithfulLeg& leg = m_kLegs[k];
    const Vec3 sourceKnee = leg.At(frame).thigh * static_cast<float>(leg.Lengths().upper);
    const Vec3 forward = Vec3Normalized(leg.Forward(matcher_)) * kForwardHint;
    Vec3 hint = TransformCoord(sourceKnee + forward, AxisSwapForward);
    Mat4 goal = kMat4Identity;
    goal.SetTranslation(TransformCoord(ankle, AxisSwapForward));
    CLegSolver::Pose pose;
    if (!m_kSolver.Solve(k, hint, goal, pose))
        return false;
    knee = TransformCoord(hint, AxisSwapBack);
    return true;
}

void CFaithfulPose::WriteLeg(size_t k, size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    const CFaithfulLeg& leg = m_kLegs[k];
    const auto& bones = matcher_.Bones();
    const auto worldOf = [&](size_t bone) { return NormalizedRows(bones[bone].world); };
    const Vec3 ankle = plan_->Ankle(k, frame);
    Vec3 knee;
    if (!IsFinite(ankle) || !SolveKnee(k, frame, ankle, knee))
        return;

    const int above = bones[leg.Thigh()].parent;
    const Mat3 pelvis = above < 0 ? kMat3Identity : worldOf(static_cast<size_t>(above));
    const Mat3 thigh = PointedTo(knee, worldOf(leg.Thigh()), bones[leg.Calf()].translation);
    const Mat3 calf = PointedTo(ankle - knee, worldOf(leg.Calf()), bones[leg.Foot()].translation);
    const Mat3 foot = worldOf(leg.Foot());
    tracks[leg.Thigh()]->m_kRotationKeys[frame] = QuatFromMat3(thigh * Mat3Transpose(pelvis));
    tracks[leg.Calf()]->m_kRotationKeys[frame] = QuatFromMat3(calf * Mat3Transpose(thigh));
    tracks[leg.Foot()]->m_kRotationKeys[frame] = QuatFromMat3(foot * Mat3Transpose(calf));
}

} // namespace gw
