#pragma once

#include "CNode.h"

#include <optional>

namespace gw {

/// Measures the axis of a hinge, a knee or an elbow, in the space of one of its two bones over many frames:
/// the mean of the axes about which the bones are bent.
class CHingeMeter
{
public:
    /// Adds the current pose, in which `upper` and `lower` are the bones' directions. Ignored if the hinge is
    /// nearly straight or folded.
    void Add(const Vec3& upper, const Vec3& lower, const CNode& bone);
    /// Returns the axis, a unit vector; nothing if the hinge hardly bends or has no consistent axis.
    std::optional<Vec3> Axis() const;

private:
    Vec3 m_kSum = kVec3Zero;
    double m_fWeight = 0.0;
    int m_iFrames = 0;
};

} // namespace gw
