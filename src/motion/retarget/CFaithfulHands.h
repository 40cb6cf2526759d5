#pragma once

#include "CFaithfulArm.h"
#include "CFaithfulLeg.h"
#include "CHandPlan.h"

#include <functional>
#include <optional>
#include <vector>

namespace gw {

/// Lets the target's hands touch what the source's touch, after its trunk and legs are posed. Two rounds over
/// the frames: Append while the source goes by; then Plan and WriteFrame.
class CFaithfulHands
{
public:
    /// Plans both arms, or none: without a root, or where an arm, a leg, neck or head is not mapped. Both
    /// trees stand in rest pose.
    CFaithfulHands(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot,
                   const std::vector<CFaithfulLeg>& legs);

    /// The source's joints that are looked at.
    std::vector<CNode*> Joints() const;
    /// Takes the source's present pose as the next frame.
    void Append();
    /// Finds what hands touch and where they are to be. `onTarget` takes a place of the source to the
    /// target's lengths and floor. The tracks hold the whole motion but for hands.
    void Plan(const std::vector<CKeyframeControl*>& tracks, const std::function<Vec3(const Vec3&)>& onTarget,
              double secondsPerFrame, bool hasFloor);
    /// Replaces the keys of the arms in a frame in which a hand is to be elsewhere.
    void WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);

private:
    void PlanBones(const std::vector<CFaithfulLeg>& legs, size_t neck, size_t head);
    TouchPoints SourceAt(size_t frame, const std::function<Vec3(const Vec3&)>& onTarget) const;
    void PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);
    TouchPoints TargetPoints() const;

    static constexpr size_t kJoints = 8;

    CPoseMatcher& matcher_;
    std::vector<CFaithfulArm> m_kArms;
    std::vector<CNode*> m_kSource; // hands, hips, knees, neck, head
    std::vector<size_t> m_kJoints; // the target's bones at the same places
    std::vector<size_t> m_kBones;  // these and those above them; parents first
    std::vector<Vec3> m_kPlaces;   // of the source, kJoints a frame
    std::optional<CHandPlan> plan_;
};

} // namespace gw
