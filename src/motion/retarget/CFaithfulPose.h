#pragma once

#include "CFaithfulHands.h"
#include "CFaithfulLeg.h"
#include "CSourceBody.h"
#include "CStandPlan.h"
#include "CTrunkAim.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;

/// Keeps a matched motion closer to the source than matching bone by bone does. The trunk leans like the
/// source's. The midpoint of the hip joints follows the source's path, scaled by leg length. Thighs and
/// calves point in the source's directions. Feet keep their rotation within a few degrees of pitch, and stand
/// still on y = 0 while the source's feet stand. Hands touch what the source's hands touch.
///
/// This takes three passes over the frames. First, call Append after each frame of the source is matched.
/// Then call Plan, which needs all frames, and WriteFrame for each frame. Finally, for the hands, call
/// PlanHands, and WriteHands for each frame.
class CFaithfulPose
{
public:
    /// Plans the legs, and the arms if `holdHands` is set; without a root, nothing. Both trees must be in
    /// rest pose.
    CFaithfulPose(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot, bool holdHands);

    /// Returns the legs that follow the source. If there are none, there is nothing to do.
    const std::vector<CFaithfulLeg>& Legs() const { return m_kLegs; }
    /// Returns the source's joints that are read.
    std::vector<CNode*> SourceJoints() const;
    /// Adds the source's current pose as the next frame, and makes the trunk of the matched pose lean like
    /// it.
    void Append();
    /// Plans the path of the root and where the feet stand; see CStandPlan. `tracks` contain the matched
    /// motion, with one key per appended frame.
    void Plan(const std::vector<CKeyframeControl*>& tracks, const Vec3& origin, double secondsPerFrame,
              bool holdFeet);
    /// Replaces the keys of root and legs in a frame. A key keeps its value if the new one is not finite.
    void WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);

    /// Plans where the hands go. Call it after WriteFrame for all frames. Does nothing if hands are not held.
    void PlanHands(const std::vector<CKeyframeControl*>& tracks, double secondsPerFrame);
    /// Replaces the arms' rotation keys in a frame.
    void WriteHands(size_t frame, const std::vector<CKeyframeControl*>& tracks);

private:
    void PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);
    ToePlace ToeMoved(size_t leg, size_t frame, double flatDrop) const;
    void SettleFeet(double secondsPerFrame, double flatDrop);
    void YieldFeet(double secondsPerFrame, double flatDrop);
    Vec3 KneePlace(size_t leg, size_t frame, const Vec3& ankle) const;
    void WriteLeg(size_t leg, size_t frame, const std::vector<CKeyframeControl*>& tracks);

    CPoseMatcher& matcher_;
    CTrunkAim m_kTrunk;
    std::vector<CFaithfulLeg> m_kLegs;
    std::vector<size_t> m_kBones; // of the legs, from the root down
    CSourceBody m_kSource;
    CFaithfulHands m_kHands;
    std::optional<CStandPlan> plan_;
};

} // namespace gw
