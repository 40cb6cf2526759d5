#pragma once

#include "CFaithfulLeg.h"
#include "CSourceBody.h"
#include "HoldFoot.h"

#include <cstddef>
#include <vector>

namespace gw {

/// Where the target's root and its ankles are to be in every frame, found from all frames at once.
class CStandPlan
{
public:
    /// The legs have read all frames of source and target; they and the source must outlive the plan. The
    /// root begins over the x and z of `origin`. Without `holdFeet` legs point as the source's, wherever the
    /// feet come to.
    CStandPlan(const std::vector<CFaithfulLeg>& legs, const CSourceBody& source, const Vec3& origin,
               double secondsPerFrame, bool holdFeet);

    const Vec3& Root(size_t frame) const { return m_kRoots[frame]; }
    /// The ankle of a leg from its hip, within the leg's reach.
    Vec3 Ankle(size_t leg, size_t frame) const;

private:
    using ContactsOfLegs = std::vector<std::vector<Contact>>;
    /// What legs that stand want of the root's height, by frame: the first and second derivative of what it
    /// costs them.
    struct Pull
    {
        std::vector<float> force;
        std::vector<float> firmness;
    };

    Vec3 Sway(size_t frame) const;
    std::vector<Vec3> SwayLead(double smoothFrames) const;
    void PlaceRoot(const Vec3& origin, double secondsPerFrame);
    float Lift(size_t leg, size_t frame) const;
    void StandOnFloor(const ContactsOfLegs& contacts);
    std::vector<Vec3> FreePath(size_t leg) const;
    std::vector<Vec3> SourcePath(size_t leg) const;
    Vec3 AskedAnkle(size_t leg, size_t frame) const;
    void AddPull(size_t leg, size_t frame, Pull& pull) const;
    void LiftRoot(double smoothFrames, std::vector<float>& lifts);

    const std::vector<CFaithfulLeg>& legs_;
    const CSourceBody& source_;
    double m_fScale; // of the source's lengths
    std::vector<Vec3> m_kRoots;
    std::vector<std::vector<FootHold>> m_kHolds; // by leg and frame; empty where feet are not held
};

} // namespace gw
