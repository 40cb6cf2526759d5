#pragma once

#include "CFaithfulLeg.h"
#include "CSourceBody.h"
#include "LandFoot.h"

#include <cstddef>
#include <vector>

namespace gw {

class CBandFit;

/// Plans where the target's root and ankles go in every frame, computed from all frames together.
class CStandPlan
{
public:
    /// Makes the plan. `legs` must already have read all frames of source and target, and `source` must have
    /// found its touches; `legs` and `source` must outlive the plan. `lowestHand` is the lowest y of the
    /// source's hands. The root starts above the x and z of `origin`. Without `holdFeet`, the legs point in
    /// the source's directions, wherever that puts the feet.
    CStandPlan(const std::vector<CFaithfulLeg>& legs, const CSourceBody& source, float lowestHand,
               const Vec3& origin, double secondsPerFrame, bool holdFeet);

    /// Returns the position of the root, in millimeters of the target.
    const Vec3& Root(size_t frame) const { return m_kRoots[frame]; }
    /// Returns the ankle relative to the hip of the same leg; it is always within the leg's reach.
    Vec3 Ankle(size_t leg, size_t frame) const;
    /// Returns a rotation by a few degrees that brings the toe end of a foot's sole to the floor.
    const Mat3& ToeTurn(size_t leg, size_t frame) const;
    /// Converts a position of the source to the target's scale and floor height. The horizontal position is
    /// only scaled, not moved to where the target is.
    Vec3 OnTarget(const Vec3& place) const;
    /// Returns whether the source stands in any frame, on its feet or its hands. In a jump that is cut out of
    /// a longer motion, for example, nothing shows where the floor is.
    bool HasFloor() const { return m_bHasFloor; }

private:
    Vec3 Hips(size_t frame) const;
    void PlaceRoot(const Vec3& origin);
    Vec3 FreeAnkle(size_t leg, size_t frame) const;
    float FreeSole(size_t leg, size_t frame) const;
    void StandOnFloor(const std::vector<FootTouches>& touches, float lowestHand);
    void HoldLeg(size_t leg, const FootTouches& touches, double secondsPerFrame);
    SoleWish WishedSole(size_t leg, size_t frame, const FootTouches& touches) const;
    void LandLeg(size_t leg, const FootTouches& touches, double secondsPerFrame);
    void AddWish(size_t leg, size_t frame, CBandFit& lifts) const;
    double WantedToeDrop(size_t leg, size_t frame) const;
    void LowerToe(size_t leg, double secondsPerFrame);
    void LiftRoot(double secondsPerFrame);
    std::vector<Vec3> Scaled(const std::vector<Vec3>& places) const;

    const std::vector<CFaithfulLeg>& legs_;
    const CSourceBody& source_;
    double m_fScale; // target lengths / source lengths
    bool m_bHasFloor = false;
    float m_fRaised = 0.0f; // what to add to the scaled source's heights to put it on the target's floor
    std::vector<Vec3> m_kRoots;
    std::vector<float> m_kLifts;                // the part of the roots' heights that was added for the legs
    std::vector<std::vector<Vec3>> m_kAnkles;   // by leg and frame; empty if feet are not held
    std::vector<std::vector<Mat3>> m_kToeTurns; // empty until they are planned
    std::vector<std::vector<float>> m_kLanded;  // confidence that a sole is on the floor
};

} // namespace gw
