#include "CFaithfulPose.h"

#include "CKeyframeControl.h"
#include "Directions.h"
#include "HostBones.h"
#include "JointSteps.h"
#include "PointBone.h"
#include "SettleFoot.h"
#include "Skeleton.h"
#include "YieldFoot.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <set>

namespace gw {

namespace {

// How much the knee's usual side counts, in millimeters. It decides for a straight leg; the knee of a bent
// one is many times farther from the line between hip and ankle.
constexpr float kForwardHint = 3.0f;

constexpr double kLeastDrop = 0.01; // millimeters by which lowering a toe is worth a rotation

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
    sources.reserve(legs.size());
    for (const CFaithfulLeg& leg : legs)
        sources.push_back(leg.Source());
    return sources;
}

// Returns the bones of all legs in the matcher's order, in which parents come first.
std::vector<size_t> BonesOf(const std::vector<CFaithfulLeg>& legs)
{
    std::set<size_t> bones;
    for (const CFaithfulLeg& leg : legs)
        bones.insert(leg.Path().begin(), leg.Path().end());
    return {bones.begin(), bones.end()};
}

bool IsFinite(const Vec3& v)
{
    return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

} // namespace

CFaithfulPose::CFaithfulPose(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot,
                             bool holdHands)
    : matcher_(matcher), m_kTrunk(retargeter, matcher, targetRoot),
      m_kLegs(PlanLegs(retargeter, matcher, targetRoot)), m_kBones(BonesOf(m_kLegs)),
      m_kSource(retargeter.SourceOf(targetRoot), SourcesOf(m_kLegs)),
      m_kHands(retargeter, matcher, holdHands ? targetRoot : nullptr, m_kLegs)
{
}

std::vector<CNode*> CFaithfulPose::SourceJoints() const
{
    std::vector<CNode*> joints = m_kSource.Joints();
    for (const std::vector<CNode*>& more : {m_kTrunk.Joints(), m_kHands.Joints()})
        joints.insert(joints.end(), more.begin(), more.end());
    return joints;
}

void CFaithfulPose::Append()
{
    m_kTrunk.Aim(matcher_);
    m_kHands.Append();
    m_kSource.Append();
    for (CFaithfulLeg& leg : m_kLegs)
        leg.AppendSource();
}

// Poses the bones of the legs as matched in a frame, with the root at the origin. Far from the origin, a
// float position is too coarse for the height of a sole.
void CFaithfulPose::PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    for (const size_t index : m_kBones)
    {
        CPoseMatcher::Bone& bone = matcher_.Bones()[index];
        bone.rotation = QuatToMat3(tracks[index]->m_kRotationKeys[frame]);
        bone.translation = bone.parent < 0 ? kVec3Zero : tracks[index]->m_kPositionKeys[frame];
        matcher_.UpdateWorld(index);
    }
}

// Returns how far the source's toe is, relative to its ankle, from where it is in a foot that stands flat, in
// the target's scale; NaN for a foot without a toe.
ToePlace CFaithfulPose::ToeMoved(size_t leg, size_t frame, double flatDrop) const
{
    const CLegTrack& track = m_kSource.Leg(leg);
    const LegLengths& lengths = m_kLegs[leg].Lengths();
    if (!track.HasToe())
        return {0.0, std::numeric_limits<double>::quiet_NaN()};
    const ToePlace place = ToePlaceOf(track.Toes()[frame] - track.Ankles()[frame]);
    const double square = place.ahead * place.ahead + place.height * place.height - flatDrop * flatDrop;
    const double scale = lengths.Straight() / m_kSource.LegLength();
    return {(place.ahead - std::sqrt(std::max(square, 0.0))) * scale, (place.height + flatDrop) * scale};
}

// Pitches a foot that stands so that its ankle is as high above the floor as the source's. If the source's
// toe sinks into the floor, only the ankle counts.
void CFaithfulPose::SettleFeet(double secondsPerFrame, double flatDrop)
{
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
    {
        CFaithfulLeg& of = m_kLegs[leg];
        if (!of.HasToe())
            continue;
        const double length = of.Lengths().Straight();
        const FootTouches& touch = m_kSource.Touches()[leg];
        std::vector<ToeWish> wishes;
        for (size_t frame = 0; frame < m_kSource.FrameCount(); ++frame)
        {
            const double heel = -ToeMoved(leg, frame, flatDrop).height;
            const double ankle = std::max(static_cast<double>(touch.states[frame].ankleHeight) * length, 0.0);
            wishes.push_back({of.At(frame).toe, of.FlatDrop() + (heel < ankle ? heel : ankle),
                              static_cast<double>(touch.states[frame].settled)});
        }
        const std::vector<double> drops = SettleFoot(wishes, secondsPerFrame);
        for (size_t frame = 0; frame < drops.size(); ++frame)
        {
            if (std::fabs(drops[frame]) > kLeastDrop)
                of.TurnFoot(frame, LoweredToe(of.At(frame).toe, drops[frame]));
        }
    }
}

// Rotates a foot that has a toe by the few degrees that keep it from sliding.
void CFaithfulPose::YieldFeet(double secondsPerFrame, double flatDrop)
{
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
    {
        CFaithfulLeg& of = m_kLegs[leg];
        const CLegTrack& track = m_kSource.Leg(leg);
        if (!track.HasToe() || !of.HasToe())
            continue;
        const double length = of.Lengths().Straight();
        const auto scale = static_cast<float>(length / m_kSource.LegLength());
        std::vector<Vec3> toe;
        std::vector<Vec3> sourceAnkle;
        std::vector<Vec3> sourceToe;
        std::vector<float> lifts;
        for (size_t frame = 0; frame < m_kSource.FrameCount(); ++frame)
        {
            toe.push_back(of.At(frame).toe);
            sourceAnkle.push_back(track.Ankles()[frame] * scale);
            sourceToe.push_back(track.Toes()[frame] * scale);
            lifts.push_back(static_cast<float>(std::fabs(ToeMoved(leg, frame, flatDrop).height)));
        }
        const FootTouches& touch = m_kSource.Touches()[leg];
        const std::vector<Mat3> turns =
            YieldFoot({toe, sourceAnkle, sourceToe, length},
                      {touch.contacts, touch.ankle, touch.toe, m_kSource.Jumps()}, lifts, secondsPerFrame);
        for (size_t frame = 0; frame < turns.size(); ++frame)
        {
            if (turns[frame] != kMat3Identity)
                of.TurnFoot(frame, turns[frame]);
        }
    }
}

void CFaithfulPose::Plan(const std::vector<CKeyframeControl*>& tracks, const Vec3& origin,
                         double secondsPerFrame, bool holdFeet)
{
    m_kSource.FindTouches(secondsPerFrame);
    const auto flatDrop = static_cast<double>(m_kSource.FlatDrop());
    for (size_t frame = 0; frame < m_kSource.FrameCount(); ++frame)
    {
        PoseFrame(frame, tracks);
        for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
            m_kLegs[leg].ReadTarget(matcher_, frame, ToeMoved(leg, frame, flatDrop));
    }
    if (holdFeet)
    {
        for (CFaithfulLeg& leg : m_kLegs)
            leg.SteadyKnee(secondsPerFrame);
        YieldFeet(secondsPerFrame, flatDrop);
        SettleFeet(secondsPerFrame, flatDrop);
    }
    plan_.emplace(m_kLegs, m_kSource, m_kHands.LowestHand(), origin, secondsPerFrame, holdFeet);
}

void CFaithfulPose::WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    PoseFrame(frame, tracks);
    if (IsFinite(plan_->Root(frame)))
        tracks.front()->m_kPositionKeys.Set(frame, plan_->Root(frame));
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
        WriteLeg(leg, frame, tracks);
}

void CFaithfulPose::PlanHands(const std::vector<CKeyframeControl*>& tracks, double secondsPerFrame)
{
    m_kHands.Plan(
        tracks, [this](const Vec3& place) { return plan_->OnTarget(place); }, secondsPerFrame,
        plan_->HasFloor());
}

void CFaithfulPose::WriteHands(size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    m_kHands.WriteFrame(frame, tracks);
}

// Returns the position of the knee relative to the hip. The knee is off the line between hip and ankle where
// the source's is. If it is bent more than the source's, it is farther off, in its usual direction: the
// direction of a nearly straight leg turns quickly, and would swing a knee that is clearly bent.
Vec3 CFaithfulPose::KneePlace(size_t k, size_t frame, const Vec3& ankle) const
{
    const CFaithfulLeg& leg = m_kLegs[k];
    const auto offAt = [&](double bend) { return std::sqrt(SquareSlopeAt(leg.Lengths(), bend)); };
    const double more = offAt(BendAt(leg.Lengths(), Vec3Length(ankle))) - offAt(leg.KneeBend(frame));
    const Vec3 forward =
        Vec3Normalized(leg.Forward(matcher_)) * (kForwardHint + static_cast<float>(std::max(more, 0.0)));
    return MiddleJoint(leg.Lengths(), ankle, leg.At(frame).knee + forward);
}

void CFaithfulPose::WriteLeg(size_t k, size_t frame, const std::vector<CKeyframeControl*>& tracks)
{
    const CFaithfulLeg& leg = m_kLegs[k];
    const auto& bones = matcher_.Bones();
    const auto worldOf = [&](size_t bone) { return NormalizedRows(bones[bone].world); };
    const Vec3 ankle = plan_->Ankle(k, frame);
    const Vec3 knee = KneePlace(k, frame, ankle);
    if (!IsFinite(ankle) || !IsFinite(knee))
        return;

    const int above = bones[leg.Thigh()].parent;
    const Mat3 pelvis = above < 0 ? kMat3Identity : worldOf(static_cast<size_t>(above));
    const Mat3 thigh = PointedTo(knee, worldOf(leg.Thigh()), bones[leg.Calf()].translation);
    const Mat3 calf = PointedTo(ankle - knee, worldOf(leg.Calf()), bones[leg.Foot()].translation);
    const Mat3 foot = worldOf(leg.Foot()) * leg.At(frame).pitch * plan_->ToeTurn(k, frame);
    tracks[leg.Thigh()]->m_kRotationKeys[frame] = QuatFromMat3(thigh * Mat3Transpose(pelvis));
    tracks[leg.Calf()]->m_kRotationKeys[frame] = QuatFromMat3(calf * Mat3Transpose(thigh));
    tracks[leg.Foot()]->m_kRotationKeys[frame] = QuatFromMat3(foot * Mat3Transpose(calf));
}

} // namespace gw
