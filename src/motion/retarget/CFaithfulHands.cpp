#include "CFaithfulHands.h"

#include "BodyPose.h"
#include "CKeyframeControl.h"
#include "CRetargeter.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <algorithm>
#include <limits>

namespace gw {

namespace {

constexpr float kHeadMiddle = 100.0f; // millimeters from the head's joint, in the neck's direction
constexpr double kLeastWay = 0.05;    // in millimeters; smaller corrections are skipped

// Sorts the eight positions of a body by what they mean to its hands.
TouchPoints PointsOf(const Vec3* places)
{
    const Vec3& neck = places[6];
    const Vec3& head = places[7];
    TouchPoints points;
    points.hands = {places[0], places[1]};
    points.hips = {places[2], places[3]};
    points.knees = {places[4], places[5]};
    points.neck = neck;
    points.head = head + Vec3Normalized(head - neck) * kHeadMiddle;
    return points;
}

} // namespace

CFaithfulHands::CFaithfulHands(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot,
                               const std::vector<CFaithfulLeg>& legs)
    : matcher_(matcher)
{
    CNode* const neck = FindNode(targetRoot, kNeckBone);
    CNode* const head = FindNode(targetRoot, kHeadBone);
    if (!targetRoot || legs.size() != 2 || !retargeter.SourceOf(neck) || !retargeter.SourceOf(head))
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
    m_kSource = {m_kArms[0].SourceHand(),   m_kArms[1].SourceHand(),  legs[0].Source().thigh,
                 legs[1].Source().thigh,    legs[0].Source().knee,    legs[1].Source().knee,
                 retargeter.SourceOf(neck), retargeter.SourceOf(head)};
    PlanBones(legs, static_cast<size_t>(matcher.IndexOf(neck)), static_cast<size_t>(matcher.IndexOf(head)));
}

void CFaithfulHands::PlanBones(const std::vector<CFaithfulLeg>& legs, size_t neck, size_t head)
{
    m_kJoints = {m_kArms[0].Hand(),
                 m_kArms[1].Hand(),
                 legs[0].Thigh(),
                 legs[1].Thigh(),
                 legs[0].Calf(),
                 legs[1].Calf(),
                 neck,
                 head};
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
    return m_kSource;
}

void CFaithfulHands::Append()
{
    for (const CNode* joint : m_kSource)
        m_kPlaces.push_back(PlaceOf(*joint));
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

// Poses the target with the root at its real height but at x = z = 0. Far from the origin, a float position
// is too coarse for a small gap.
void CFaithfulHands::PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    for (const size_t index : m_kBones)
    {
        CPoseMatcher::Bone& bone = matcher_.Bones()[index];
        bone.rotation = QuatToMat3(tracks[index]->m_kRotationKeys[frame]);
        bone.translation = tracks[index]->m_kPositionKeys[frame];
        if (bone.parent < 0)
            bone.translation = {0.0f, bone.translation.y, 0.0f};
        matcher_.UpdateWorld(index);
    }
}

TouchPoints CFaithfulHands::TargetPoints() const
{
    Vec3 places[kJoints];
    std::ranges::transform(m_kJoints, places,
                           [&](size_t bone) { return matcher_.Bones()[bone].world.Translation(); });
    TouchPoints points = PointsOf(places);
    for (size_t side = 0; side < m_kArms.size(); ++side)
    {
        points.shoulders[side] = m_kArms[side].Shoulder(matcher_);
        points.reach[side] = m_kArms[side].Reach();
    }
    return points;
}

void CFaithfulHands::Plan(const std::vector<CKeyframeControl*>& tracks,
                          const std::function<Vec3(const Vec3&)>& onTarget, double secondsPerFrame,
                          bool hasFloor)
{
    const size_t frameCount = m_kPlaces.size() / kJoints;
    CHandPlan plan(frameCount, secondsPerFrame, hasFloor);
    bool touches = false;
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        const TouchPoints source = SourceAt(frame, onTarget);
        if (!plan.Touches(source))
            continue;
        PoseFrame(frame, tracks);
        for (CFaithfulArm& arm : m_kArms)
            arm.ReadPose(matcher_);
        plan.Add(frame, source, TargetPoints());
        touches = true;
    }
    if (!touches)
        return;
    plan.Solve();
    plan_ = std::move(plan);
}

void CFaithfulHands::WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    if (!plan_ || std::max(Vec3Length(plan_->Way(0, frame)), Vec3Length(plan_->Way(1, frame))) < kLeastWay)
        return;
    PoseFrame(frame, tracks);
    for (size_t side = 0; side < m_kArms.size(); ++side)
        m_kArms[side].MoveHand(matcher_, plan_->Way(side, frame), frame, tracks);
}

} // namespace gw
