#pragma once

#include "CFeetTrack.h"

#include <vector>

namespace gw {

class CNode;

/// What root, hips and feet of a source do, frame by frame.
class CSourceBody
{
public:
    /// `root` is the joint that drives the target's root; null for one that does not move. The tree stands in
    /// rest pose.
    CSourceBody(const CNode* root, const std::vector<LegJoints>& legs);

    /// The joints that are looked at.
    std::vector<CNode*> Joints() const;
    /// Takes the present pose as the next frame; the first one tells how long the legs are.
    void Append();

    size_t FrameCount() const { return m_kRoots.size(); }
    /// The legs' mean length.
    double LegLength() const { return m_kFeet.LegLength(); }
    const Vec3& Root(size_t frame) const { return m_kRoots[frame]; }
    /// The middle of the hip joints.
    const Vec3& Hips(size_t frame) const { return m_kHips[frame]; }
    const CLegTrack& Leg(size_t leg) const { return m_kFeet.Legs()[leg]; }
    /// The contacts of each leg; none where legs have no length.
    std::vector<std::vector<Contact>> Contacts(double secondsPerFrame) const;
    /// What each leg touches the floor with; nothing where legs have no length.
    std::vector<FootTouches> Touches(double secondsPerFrame) const;

private:
    bool HasLegs() const;

    const CNode* m_pkRoot;
    std::vector<LegJoints> m_kLegs;
    CFeetTrack m_kFeet;
    std::vector<Vec3> m_kRoots;
    std::vector<Vec3> m_kHips;
};

} // namespace gw
