#pragma once

#include "CFaithfulLeg.h"
#include "CLegSolver.h"
#include "CSourceBody.h"
#include "CStandPlan.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;

/// Lets a matched motion keep to the source where the plain rules do not: the root goes as far as the
/// source's and the middle of the hip joints stands as high over the ground, in leg lengths; thighs and
/// calves point as the source's; feet keep their turn, and stand still on y = 0 where the source's stand.
///
/// It takes two rounds over the frames: Append while the source goes by and is matched; then Plan, which
/// needs all of it, and WriteFrame.
class CFaithfulPose
{
public:
    /// Plans the legs, or none without a root. Both trees stand in rest pose.
    CFaithfulPose(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode* targetRoot);

    /// The legs that keep to their source. Without one there is nothing to do.
    const std::vector<CFaithfulLeg>& Legs() const { return m_kLegs; }
    /// The source's joints that are looked at.
    std::vector<CNode*> SourceJoints() const { return m_kSource.Joints(); }
    /// Takes the source's present pose as the next frame.
    void Append();
    /// Finds the root's way and where feet stand; see CStandPlan. The tracks hold the matched motion, as many
    /// frames as were appended.
    void Plan(const std::vector<CKeyframeControl*>& tracks, const Vec3& origin, double secondsPerFrame,
              bool holdFeet);
    /// Replaces the keys of root and legs in a frame. A key for which there is no finite value stays.
    void WriteFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);

private:
    void PoseFrame(size_t frame, const std::vector<CKeyframeControl*>& tracks);
    bool SolveKnee(size_t leg, size_t frame, const Vec3& ankle, Vec3& knee);
    void WriteLeg(size_t leg, size_t frame, const std::vector<CKeyframeControl*>& tracks);

    CPoseMatcher& matcher_;
    std::vector<CFaithfulLeg> m_kLegs;
    CSourceBody m_kSource;
    CLegSolver m_kSolver;
    std::optional<CStandPlan> plan_;
};

} // namespace gw
