#pragma once

#include "CLegSolver.h"
#include "CPoseMatcher.h"

#include <vector>

namespace gw {

class CFaithfulLeg;
class CKeyframeControl;
class CNodeNames;
struct HostSide;

/// Plants the feet: rotates thigh and calf of each leg so that the ankle's position relative to the pelvis
/// matches the source's, scaled. Feet keep their rotation.
class CLegPlanter
{
public:
    /// Plans the legs LThigh to LFoot and RThigh to RFoot. A leg with a missing bone or source is not
    /// planted.
    CLegPlanter(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode& targetRoot);

    /// Excludes legs that are posed by other means.
    void LeaveOut(const std::vector<CFaithfulLeg>& legs);

    /// Replaces the rotation keys of a frame for each leg that can be solved. `tracks` are in bone order;
    /// `scale` is the body scale.
    void Plant(size_t frame, float scale, const std::vector<CKeyframeControl*>& tracks);

private:
    struct LegRecord
    {
        size_t thigh;
        size_t calf;
        size_t foot;
        const CNode* sourceFoot;
        const CNode* sourceThigh; ///< source of the calf's parent; can be null
        Mat3 thighOffset;
        Mat3 calfOffset;
        std::vector<size_t> path; ///< from the root down to the calf
    };

    bool Plan(const CRetargeter& retargeter, const CNodeNames& names, const HostSide& side);
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
