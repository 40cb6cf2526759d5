#include "CFaithfulHands.h"

#include "BodyPose.h"
#include "CKeyframeControl.h"
#include "CRetargeter.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>
#include <utility>

namespace gw {

namespace {

constexpr double kLeastTurn = 3e-4; // in radians; smaller turns are skipped

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr Vec3 kNowhere{kNaN, kNaN, kNaN}; // of a joint that is missing: nothing touches it

// Sorts the eight positions of a body by what they mean to its hands.
TouchPoints PointsOf(const Vec3* places)
{
    return {
        {places[0], places[1]},
        {places[2], places[3]},
        {places[4], places[5]},
        places[6], places[7]
    };
}

double SizeOf(const ArmTurn& turn)
{
    return Vec3Length(turn.turn) + std::fabs(turn.bend) + std::fabs(turn.raise);
}

} // namespace

CFaithfulHands::CFaithfulHands(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot,
                               const std::vector<CFaithfulLeg>& legs)
    : matcher_(matcher)
{
    const CNode* neck = FindNode(targetRoot, kNeckBone);
    const CNode* head = FindNode(targetRoot, kHeadBone);
    if (!neck || !head || legs.size() != 2)
        return;
    for (const HostSide& side : kHostSides)
    {
        if (auto arm = CFaithfulArm::Plan(retargeter, matcher, *targetRoot, side))
            m_kArms.push_back(std::move(*arm));
    }
    if (m_kArms.size() != 2)
    {
        m_kArms.clear();
        return;
    }
    CNode* sourceNeck = retargeter.SourceOf(neck);
    CNode* sourceHead = retargeter.SourceOf(head);
    if (!sourceNeck)
    {
        neck = head;
        sourceNeck = std::exchange(sourceHead, nullptr);
    }
    m_kSource = {m_kArms[0].SourceHand(),
                 m_kArms[1].SourceHand(),
                 legs[0].Source().thigh,
                 legs[1].Source().thigh,
                 legs[0].Source().knee,
                 legs[1].Source().knee,
                 sourceNeck,
                 sourceHead};
    PlanBones(legs, neck, head);
}

void CFaithfulHands::PlanBones(const std::vector<CFaithfulLeg>& legs, const CNode* neck, const CNode* head)
{
    m_kJoints = {m_kArms[0].Hand(),
                 m_kArms[1].Hand(),
                 legs[0].Thigh(),
                 legs[1].Thigh(),
                 legs[0].Calf(),
                 legs[1].Calf(),
                 static_cast<size_t>(matcher_.IndexOf(neck)),
                 static_cast<size_t>(matcher_.IndexOf(head))};
    std::vector<bool> looked(matcher_.Bones().size(), false);
    for (const size_t joint : m_kJoints)
    {
        for (int bone = static_cast<int>(joint); bone >= 0;
             bone = matcher_.Bones()[static_cast<size_t>(bone)].parent)
            looked[static_cast<size_t>(bone)] = true;
    }
    for (size_t bone = 0; bone < looked.size(); ++bone)
    {
        if (looked[bone])
            m_kBones.push_back(bone);
    }
}

std::vector<CNode*> CFaithfulHands::Joints() const
{
    std::vector<CNode*> joints;
    std::ranges::copy_if(m_kSource, std::back_inserter(joints), [](const CNode* joint) { return joint; });
    return joints;
}

void CFaithfulHands::Append()
{
    for (const CNode* joint : m_kSource)
        m_kPlaces.push_back(joint ? PlaceOf(*joint) : kNowhere);
}

float CFaithfulHands::LowestHand() const
{
    float lowest = std::numeric_limits<float>::infinity();
    for (size_t first = 0; first + kJoints <= m_kPlaces.size(); first += kJoints)
        lowest = std::min({lowest, m_kPlaces[first].y, m_kPlaces[first + 1].y});
    return lowest;
}

TouchPoints CFaithfulHands::SourceAt(size_t frame, const std::function<Vec3(const Vec3&)>& onTarget) const
{
    Vec3 places[kJoints];
    std::transform(m_kPlaces.begin() + static_cast<std::ptrdiff_t>(frame * kJoints),
                   m_kPlaces.begin() + static_cast<std::ptrdiff_t>((frame + 1) * kJoints), places, onTarget);
    return PointsOf(places);
}

// Poses bones of the target, parents first, with the root at its real height but at x = z = 0. Far from the
// origin, a float position is too coarse for a small gap.
void CFaithfulHands::Pose(const std::vector<size_t>& bones, size_t frame,
                          const std::vector<CKeyframeControl*>& tracks)
{
    for (const size_t index : bones)
    {
        CPoseMatcher::Bone& bone = matcher_.Bones()[index];
        bone.rotation = QuatToMat3(tracks[index]->m_kRotationKeys[frame]);
        bone.translation = tracks[index]->m_kPositionKeys[frame];
        if (bone.parent < 0)
            bone.translation = {0.0f, bone.translation.y, 0.0f};
        matcher_.UpdateWorld(index);
    }
}

ArmPoints CFaithfulHands::TargetPoints() const
{
    Vec3 places[kJoints];
    std::ranges::transform(m_kJoints, places,
                           [&](size_t bone) { return matcher_.Bones()[bone].world.Translation(); });
    ArmPoints points{PointsOf(places), {}, {}, m_kArms[0].ChestUp(matcher_)};
    for (size_t side = 0; side < m_kArms.size(); ++side)
    {
        points.collars[side] = m_kArms[side].Collar(matcher_);
        points.shoulders[side] = m_kArms[side].Shoulder(matcher_);
    }
    return points;
}

void CFaithfulHands::Plan(const std::vector<CKeyframeControl*>& tracks,
                          const std::function<Vec3(const Vec3&)>& onTarget, double secondsPerFrame,
                          bool hasFloor)
{
    const size_t frameCount = m_kArms.empty() ? 0 : m_kPlaces.size() / kJoints;
    if (frameCount == 0)
        return;
    CHandPlan plan({m_kArms[0].Lengths(), m_kArms[1].Lengths()}, frameCount, secondsPerFrame, hasFloor);
    bool touches = false;
    for (size_t sample = 0; sample < plan.SampleCount(); ++sample)
    {
        const size_t frame = plan.FrameOf(sample);
        const TouchPoints source = SourceAt(frame, onTarget);
        if (!plan.Touches(source))
            continue;
        Pose(m_kBones, frame, tracks);
        for (CFaithfulArm& arm : m_kArms)
            arm.ReadPose(matcher_);
        plan.Add(sample, source, TargetPoints());
        touches = true;
    }
    if (!touches)
        return;
    plan.Solve();
    plan_ = std::move(plan);
}

void CFaithfulHands::WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    if (!plan_)
        return;
    for (size_t side = 0; side < m_kArms.size(); ++side)
    {
        const ArmTurn turn = plan_->Turn(side, frame);
        if (SizeOf(turn) < kLeastTurn)
            continue;
        Pose(m_kArms[side].Path(), frame, tracks);
        m_kArms[side].Turn(matcher_, turn, frame, tracks);
    }
}

} // namespace gw
