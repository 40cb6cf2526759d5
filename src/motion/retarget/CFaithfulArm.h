#pragma once

#include "ArmTurn.h"
#include "CPoseMatcher.h"

#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;
struct HostSide;

/// One arm of the target, whose hand can be moved without changing more of the pose than its collar bone.
class CFaithfulArm
{
public:
    /// Plans the arm on one side. Returns nothing if a bone, including the hand, is missing or has no source.
    static std::optional<CFaithfulArm> Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                            CNode& targetRoot, const HostSide& side);

    /// Returns the source's joint that drives the hand.
    CNode* SourceHand() const { return m_pkSourceHand; }
    /// Returns the indices of the target's bones from the root down to the hand.
    const std::vector<size_t>& Path() const { return m_kPath; }
    /// Returns the index of the target's hand bone.
    size_t Hand() const { return m_kPath.back(); }
    const LegLengths& Lengths() const { return m_kLengths; }
    /// Returns the positions of the collar's and the upper arm's joints in the matcher's current pose.
    Vec3 Collar(const CPoseMatcher& matcher) const;
    Vec3 Shoulder(const CPoseMatcher& matcher) const;
    /// Returns the chest's up axis in the matcher's current pose.
    Vec3 ChestUp(const CPoseMatcher& matcher) const;
    /// Records the elbow's side in the matcher's current pose. A straight arm later bends to the usual side.
    void ReadPose(const CPoseMatcher& matcher);
    /// Turns the arm of the matcher's current pose and replaces its rotation keys in that frame. The elbow
    /// stays on its side of the arm, and the hand keeps its world rotation. The keys are left alone if the
    /// result is not finite.
    void Turn(const CPoseMatcher& matcher, const ArmTurn& turn, size_t frame,
              const std::vector<CKeyframeControl*>& tracks) const;

private:
    CFaithfulArm() = default;
    // Of the arm's bones and those above them.
    enum EBone : size_t
    {
        kHandBone,
        kForearmBone,
        kUpperArmBone,
        kCollarBone,
        kChestBone,
        kBoneCount
    };
    size_t Bone(EBone bone) const { return m_kPath[m_kPath.size() - 1 - bone]; }
    Vec3 Place(const CPoseMatcher& matcher, EBone bone) const;
    Mat3 Rotation(const CPoseMatcher& matcher, EBone bone) const;
    Vec3 Pole(const CPoseMatcher& matcher) const;

    CNode* m_pkSourceHand = nullptr;
    std::vector<size_t> m_kPath;
    LegLengths m_kLengths{};
    Vec3 m_kBend = kVec3Zero; // the elbow's offsets from the line shoulder-hand, summed; upper arm's space
};

} // namespace gw
