#pragma once

#include "CFaithfulLeg.h"
#include "CSourceBody.h"

#include <cstddef>
#include <vector>

namespace gw {

class CBandFit;

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
    /// A place of the source in the target's lengths and over its floor, but not over the same point of it.
    Vec3 OnTarget(const Vec3& place) const;
    /// Whether the source stands in any frame: a diver has no floor.
    bool HasFloor() const { return m_bHasFloor; }

private:
    using ContactsOfLegs = std::vector<std::vector<Contact>>;

    Vec3 Hips(size_t frame) const;
    void PlaceRoot(const Vec3& origin);
    Vec3 FreeAnkle(size_t leg, size_t frame) const;
    float FreeSole(size_t leg, size_t frame) const;
    void StandOnFloor(const ContactsOfLegs& contacts);
    void HoldLeg(size_t leg, const std::vector<Contact>& contacts, double secondsPerFrame);
    void LandLeg(size_t leg, const std::vector<float>& landed, double secondsPerFrame);
    void AddWish(size_t leg, size_t frame, CBandFit& lifts) const;
    void LiftRoot(double secondsPerFrame);
    std::vector<Vec3> Scaled(const std::vector<Vec3>& places) const;

    const std::vector<CFaithfulLeg>& legs_;
    const CSourceBody& source_;
    double m_fScale; // of the source's lengths
    bool m_bHasFloor = false;
    float m_fRaised = 0.0f; // how much higher the source stands on the target's scale
    std::vector<Vec3> m_kRoots;
    std::vector<float> m_kLifts;               // what of the roots' heights has been added for the legs
    std::vector<std::vector<Vec3>> m_kAnkles;  // by leg and frame; empty where feet are not held
    std::vector<std::vector<float>> m_kLanded; // how surely a sole is on the floor, by leg and frame
};

} // namespace gw
