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

/// Lets a matched motion keep to the source where the plain rules do not: the trunk leans as the source's;
/// the middle of the hip joints goes the source's way, in leg lengths; thighs and calves point as the
/// source's; feet keep their turn, and stand still on y = 0 where the source's stand; hands touch what the
/// source's touch.
///
/// It takes three rounds over the frames: Append while the source goes by and is matched; then Plan, which
/// needs all of it, and WriteFrame; then, for hands, PlanHands and WriteHands.
class CFaithfulPose
{
public:
    /// Plans the legs, or none without a root, and the arms where hands are to be held. Both trees stand in
    /// rest pose.
    CFaithfulPose(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot, bool holdHands);

    /// The legs that keep to their source. Without one there is nothing to do.
    const std::vector<CFaithfulLeg>& Legs() const { return m_kLegs; }
    /// The source's joints that are looked at.
    std::vector<CNode*> SourceJoints() const;
    /// Takes the source's present pose as the next frame, and lets the trunk of the matched pose lean as it
    /// does.
    void Append();
    /// Finds the root's way and where feet stand; see CStandPlan. The tracks hold the matched motion, as many
    /// frames as were appended.
    void Plan(const std::vector<CKeyframeControl*>& tracks, const Vec3& origin, double secondsPerFrame,
              bool holdFeet);
    /// Replaces the keys of root and legs in a frame. A key for which there is no finite value stays.
    void WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);

    /// Finds where hands are to be, once all frames are written; does nothing where they are not held.
    void PlanHands(const std::vector<CKeyframeControl*>& tracks, double secondsPerFrame);
    /// Replaces the keys of the arms in a frame.
    void WriteHands(size_t frame, const std::vector<CKeyframeControl*>& tracks);

private:
    void PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);
    Vec3 KneePlace(size_t leg, size_t frame, const Vec3& ankle) const;
    void WriteLeg(size_t leg, size_t frame, const std::vector<CKeyframeControl*>& tracks);

    CPoseMatcher& matcher_;
    CTrunkAim m_kTrunk;
    std::vector<CFaithfulLeg> m_kLegs;
    CSourceBody m_kSource;
    CFaithfulHands m_kHands;
    std::optional<CStandPlan> plan_;
};

} // namespace gw
