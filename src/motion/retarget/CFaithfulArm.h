#pragma once

#include "CPoseMatcher.h"
#include "YieldKnee.h"

#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;
struct HostSide;

/// One arm of the target whose hand can be moved by bending the elbow.
class CFaithfulArm
{
public:
    /// Nothing where a bone is missing or without a source of its own, hands included.
    static std::optional<CFaithfulArm> Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                            CNode& targetRoot, const HostSide& side);

    CNode* SourceHand() const { return m_pkSourceHand; }
    /// The target's bones from the root down to the hand.
    const std::vector<size_t>& Path() const { return m_kPath; }
    size_t Hand() const { return m_kPath.back(); }
    /// Takes the elbow of the matcher's present pose into account for arms that are straight.
    void ReadPose(const CPoseMatcher& matcher);
    /// Moves the hand in the matcher's present pose: the elbow stays in its plane, the hand keeps its turn.
    /// Replaces the keys of a frame.
    void MoveHand(const CPoseMatcher& matcher, const Vec3& way, size_t frame,
                  const std::vector<CKeyframeControl*>& tracks) const;

private:
    CFaithfulArm() = default;
    Vec3 Pole(const CPoseMatcher& matcher) const;

    CNode* m_pkSourceHand = nullptr;
    std::vector<size_t> m_kPath;
    LegLengths m_kLengths{};
    Vec3 m_kBend = kVec3Zero; // sum over the frames of where the elbow stands off, in the upper arm's space
};

} // namespace gw
