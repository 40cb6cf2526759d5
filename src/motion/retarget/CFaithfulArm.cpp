#include "CFaithfulArm.h"

#include "CKeyframeControl.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "HostBones.h"
#include "PointBone.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// How much the elbow's usual side counts, in millimeters. It decides for a straight arm; the elbow of a bent
// one is ten times farther from the line.
constexpr float kUsualSide = 5.0f;
// A straighter arm yields little, so a hand does not get where it should with one.
constexpr double kComfortable = 0.95;

Vec3 PlaceOfBone(const CPoseMatcher& matcher, size_t bone)
{
    return matcher.Bones()[bone].world.Translation();
}

Mat3 TurnOfBone(const CPoseMatcher& matcher, size_t bone)
{
    return NormalizedRows(matcher.Bones()[bone].world);
}

} // namespace

std::optional<CFaithfulArm> CFaithfulArm::Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                               CNode& targetRoot, const HostSide& side)
{
    CNode* const hand = FindNode(&targetRoot, side.hand);
    CNode* const forearm = FindNode(&targetRoot, side.forearm);
    CNode* const upperArm = FindNode(&targetRoot, side.upperArm);
    if (!hand || !forearm || !upperArm || hand->GetParentNode() != forearm ||
        forearm->GetParentNode() != upperArm || !upperArm->GetParentNode() || !retargeter.SourceOf(forearm) ||
        !retargeter.SourceOf(upperArm))
        return std::nullopt;
    CFaithfulArm arm;
    arm.m_pkSourceHand = retargeter.SourceOf(hand);
    if (!arm.m_pkSourceHand)
        return std::nullopt;
    for (const CNode* node = hand; node && matcher.IndexOf(node) >= 0; node = node->GetParentNode())
        arm.m_kPath.push_back(static_cast<size_t>(matcher.IndexOf(node)));
    std::ranges::reverse(arm.m_kPath);
    arm.m_kLengths = {Vec3Length(forearm->m_kMatrix.Translation()),
                      Vec3Length(hand->m_kMatrix.Translation())};
    return arm;
}

Vec3 CFaithfulArm::Shoulder(const CPoseMatcher& matcher) const
{
    return PlaceOfBone(matcher, m_kPath[m_kPath.size() - 3]);
}

double CFaithfulArm::Reach() const
{
    return kComfortable * (m_kLengths.upper + m_kLengths.lower);
}

// Returns the elbow's offset from the line between shoulder and hand.
Vec3 CFaithfulArm::Pole(const CPoseMatcher& matcher) const
{
    const size_t last = m_kPath.size() - 1;
    const Vec3 shoulder = PlaceOfBone(matcher, m_kPath[last - 2]);
    const Vec3 line = Vec3Normalized(PlaceOfBone(matcher, m_kPath[last]) - shoulder);
    return Across(PlaceOfBone(matcher, m_kPath[last - 1]) - shoulder, line);
}

void CFaithfulArm::ReadPose(const CPoseMatcher& matcher)
{
    m_kBend = m_kBend + ToLocal(Pole(matcher), TurnOfBone(matcher, m_kPath[m_kPath.size() - 3]));
}

void CFaithfulArm::MoveHand(const CPoseMatcher& matcher, const Vec3& way, size_t frame,
                            const std::vector<CKeyframeControl*>& tracks) const
{
    const size_t last = m_kPath.size() - 1;
    const size_t upperArm = m_kPath[last - 2];
    const size_t forearm = m_kPath[last - 1];
    const size_t hand = m_kPath[last];
    const Vec3 shoulder = PlaceOfBone(matcher, upperArm);
    const Vec3 free = PlaceOfBone(matcher, hand) - shoulder;
    const Vec3 asked = free + way;
    const double bend = BendAt(m_kLengths, Vec3Length(free));
    const double reach =
        ReachAt(m_kLengths, YieldingBend(m_kLengths, Vec3Length(asked), bend, kElbowStiffness));
    const Vec3 goal = Vec3Normalized(asked) * static_cast<float>(reach);
    const Vec3 usual = Vec3Normalized(Turned(m_kBend, TurnOfBone(matcher, upperArm))) * kUsualSide;
    const Vec3 elbow = MiddleJoint(m_kLengths, goal, Pole(matcher) + usual);
    if (!std::isfinite(Vec3Dot(elbow, elbow)))
        return;
    const auto& bones = matcher.Bones();
    const Mat3 above = TurnOfBone(matcher, m_kPath[last - 3]);
    const Mat3 upper = PointedTo(elbow, TurnOfBone(matcher, upperArm), bones[forearm].translation);
    const Mat3 lower = PointedTo(goal - elbow, TurnOfBone(matcher, forearm), bones[hand].translation);
    const Mat3 palm = TurnOfBone(matcher, hand);
    tracks[upperArm]->m_kRotationKeys[frame] = QuatFromMat3(upper * Mat3Transpose(above));
    tracks[forearm]->m_kRotationKeys[frame] = QuatFromMat3(lower * Mat3Transpose(upper));
    tracks[hand]->m_kRotationKeys[frame] = QuatFromMat3(palm * Mat3Transpose(lower));
}

} // namespace gw
