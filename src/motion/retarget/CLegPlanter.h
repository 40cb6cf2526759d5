#pragma once

#include "CLegSolver.h"
#include "CPoseMatcher.h"

#include <vector>

namespace gw {

class CFaithfulLeg;
class CKeyframeControl;
struct HostSide;

/// Plants the feet: turns the thigh and calf of each leg so that the ankle stands where the source's does,
/// scaled, as seen from the pelvis. Feet keep the rotation that they have.
class CLegPlanter
{
public:
    /// Plans the legs LThigh to LFoot and RThigh to RFoot. A leg of which a bone or a source is missing is
    /// left alone.
    CLegPlanter(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode& targetRoot);

    /// Leaves legs alone from now on that are posed otherwise.
    void LeaveOut(const std::vector<CFaithfulLeg>& legs);

    /// Replaces the rotation keys of a frame where a leg can be solved. `tracks` stand in the order of the
    /// bones; `scale` is the body measure.
    void Plant(size_t frame, float scale, const std::vector<CKeyframeControl*>& tracks);

private:
    struct LegRecord
    {
        size_t thigh;
        size_t calf;
        size_t foot;
        const CNode* sourceFoot;
        const CNode* sourceThigh; ///< of the calf's parent; may be null
        Mat3 thighOffset;
        Mat3 calfOffset;
        std::vector<size_t> path; ///< from the root down to the calf
    };

    bool Plan(const CRetargeter& retargeter, CNode& targetRoot, const HostSide& side);
    void UpdatePath(const LegRecord& leg);
    Vec3 HintPoint(const LegRecord& leg) const;
    void LegGoal(const LegRecord& leg, float scale, Vec3& goal, Vec3& hint) const;
    void PlantLeg(size_t k, size_t frame, float scale, const std::vector<CKeyframeControl*>& tracks);
    double SegmentLength(size_t bone) const;

    CPoseMatcher& matcher_;
    std::vector<LegRecord> m_kLegs;
    int m_iTorso;
    const CNode* m_pkSourcePelvis;
    CLegSolver m_kSolver;
};

} // namespace gw
