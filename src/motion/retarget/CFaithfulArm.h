#pragma once

#include "CPoseMatcher.h"
#include "YieldKnee.h"

#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;
struct HostSide;

/// One arm of the target, whose hand can be moved by bending the elbow.
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
    /// Returns the position of the upper arm's joint in the matcher's current pose.
    Vec3 Shoulder(const CPoseMatcher& matcher) const;
    /// Returns how far from its shoulder a hand can easily be moved.
    double Reach() const;
    size_t Hand() const { return m_kPath.back(); }
    /// Records the elbow's side in the matcher's current pose. A straight arm later bends to the usual side.
    void ReadPose(const CPoseMatcher& matcher);
    /// Moves the hand of the matcher's current pose by `way` (world space, in the target's units) and
    /// replaces the arm's rotation keys in that frame. The elbow stays in its plane, and the hand keeps its
    /// world rotation. The keys are left alone if there is no finite solution.
    void MoveHand(const CPoseMatcher& matcher, const Vec3& way, size_t frame,
                  const std::vector<CKeyframeControl*>& tracks) const;

private:
    CFaithfulArm() = default;
    Vec3 Pole(const CPoseMatcher& matcher) const;

    CNode* m_pkSourceHand = nullptr;
    std::vector<size_t> m_kPath;
    LegLengths m_kLengths{};
    Vec3 m_kBend = kVec3Zero; // the elbow's offsets from the line shoulder-hand, summed; upper arm's space
};

} // namespace gw
