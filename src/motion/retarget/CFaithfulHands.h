#pragma once

#include "CFaithfulArm.h"
#include "CFaithfulLeg.h"
#include "CHandPlan.h"

#include <functional>
#include <optional>
#include <vector>

namespace gw {

/// Makes the target's hands touch what the source's hands touch, once its trunk and legs are posed. This
/// takes two passes over the frames: call Append for each frame of the source, then Plan, then WriteFrame for
/// each frame.
class CFaithfulHands
{
public:
    /// Plans both arms. If the root, an arm or a leg is missing or not mapped, neither arm is moved. If the
    /// neck is not mapped, the trunk ends at the head. Both trees must be in rest pose.
    CFaithfulHands(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot,
                   const std::vector<CFaithfulLeg>& legs);

    /// Returns the source's joints that are read.
    std::vector<CNode*> Joints() const;
    /// Adds the source's current pose as the next frame.
    void Append();
    /// Returns the lowest y of the source's hands, in the source's units; infinity without hands.
    float LowestHand() const;
    /// Finds what the hands touch and where they must go. `onTarget` converts a position of the source to the
    /// target's scale and floor. `tracks` contain the finished motion except for the hands.
    void Plan(const std::vector<CKeyframeControl*>& tracks, const std::function<Vec3(const Vec3&)>& onTarget,
              double secondsPerFrame, bool hasFloor);
    /// Replaces the arms' rotation keys in a frame if a hand has to move.
    void WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);

private:
    void PlanBones(const std::vector<CFaithfulLeg>& legs, const CNode* neck, const CNode* head);
    TouchPoints SourceAt(size_t frame, const std::function<Vec3(const Vec3&)>& onTarget) const;
    void Pose(const std::vector<size_t>& bones, size_t frame, const std::vector<CKeyframeControl*>& tracks);
    ArmPoints TargetPoints() const;

    static constexpr size_t kJoints = 8;

    CPoseMatcher& matcher_;
    std::vector<CFaithfulArm> m_kArms;
    std::vector<CNode*> m_kSource; // hands, hips, knees, neck, head; null if the neck or head is missing
    std::vector<size_t> m_kJoints; // the target's bones, in the same order
    std::vector<size_t> m_kBones;  // m_kJoints and all bones above them; parents first
    std::vector<Vec3> m_kPlaces;   // positions of m_kSource, kJoints per frame
    std::optional<CHandPlan> plan_;
};

} // namespace gw
