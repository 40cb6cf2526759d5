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
    if (arm.m_kPath.size() < kBoneCount)
        return std::nullopt;
    std::ranges::reverse(arm.m_kPath);
    arm.m_kLengths = {Vec3Length(forearm->m_kMatrix.Translation()),
                      Vec3Length(hand->m_kMatrix.Translation())};
    return arm;
}

Vec3 CFaithfulArm::Place(const CPoseMatcher& matcher, EBone bone) const
{
    return matcher.Bones()[Bone(bone)].world.Translation();
}

Mat3 CFaithfulArm::Rotation(const CPoseMatcher& matcher, EBone bone) const
{
    return NormalizedRows(matcher.Bones()[Bone(bone)].world);
}

Vec3 CFaithfulArm::Collar(const CPoseMatcher& matcher) const
{
    return Place(matcher, kCollarBone);
}

Vec3 CFaithfulArm::Shoulder(const CPoseMatcher& matcher) const
{
    return Place(matcher, kUpperArmBone);
}

Vec3 CFaithfulArm::ChestUp(const CPoseMatcher& matcher) const
{
    return Rotation(matcher, kChestBone).Row(1);
}

// Returns the elbow's offset from the line between shoulder and hand.
Vec3 CFaithfulArm::Pole(const CPoseMatcher& matcher) const
{
    const Vec3 shoulder = Place(matcher, kUpperArmBone);
    const Vec3 line = Vec3Normalized(Place(matcher, kHandBone) - shoulder);
    return Across(Place(matcher, kForearmBone) - shoulder, line);
}

void CFaithfulArm::ReadPose(const CPoseMatcher& matcher)
{
    m_kBend = m_kBend + ToLocal(Pole(matcher), Rotation(matcher, kUpperArmBone));
}

void CFaithfulArm::Turn(const CPoseMatcher& matcher, const ArmTurn& turn, size_t frame,
                        const std::vector<CKeyframeControl*>& tracks) const
{
    const Vec3 shoulder = Place(matcher, kUpperArmBone);
    const Vec3 usual = Vec3Normalized(Turned(m_kBend, Rotation(matcher, kUpperArmBone))) * kUsualSide;
    const Vec3 goal = TurnedHand(m_kLengths, Place(matcher, kHandBone) - shoulder, turn);
    const Vec3 elbow = MiddleJoint(m_kLengths, goal, Rotated(Pole(matcher) + usual, turn.turn));
    if (!std::isfinite(Vec3Dot(elbow, elbow)))
        return;
    const auto& bones = matcher.Bones();
    const Mat3 chest = Rotation(matcher, kChestBone);
    const Vec3 collarWay = TurnedCollar(shoulder - Place(matcher, kCollarBone), chest.Row(1), turn);
    const Mat3 collar =
        PointedTo(collarWay, Rotation(matcher, kCollarBone), bones[Bone(kUpperArmBone)].translation);
    const Mat3 upper =
        PointedTo(elbow, Rotation(matcher, kUpperArmBone), bones[Bone(kForearmBone)].translation);
    const Mat3 lower =
        PointedTo(goal - elbow, Rotation(matcher, kForearmBone), bones[Bone(kHandBone)].translation);
    const Mat3 palm = Rotation(matcher, kHandBone);
    tracks[Bone(kCollarBone)]->m_kRotationKeys[frame] = QuatFromMat3(collar * Mat3Transpose(chest));
    tracks[Bone(kUpperArmBone)]->m_kRotationKeys[frame] = QuatFromMat3(upper * Mat3Transpose(collar));
    tracks[Bone(kForearmBone)]->m_kRotationKeys[frame] = QuatFromMat3(lower * Mat3Transpose(upper));
    tracks[Bone(kHandBone)]->m_kRotationKeys[frame] = QuatFromMat3(palm * Mat3Transpose(lower));
}

} // namespace gw
