#pragma once

#include "CNode.h"

#include <optional>

namespace gw {

/// Where the axis of a hinge, a knee or an elbow, lies in the space of one of its two bones while frames go
/// by: the mean of the axes about which the bones are bent.
class CHingeMeter
{
public:
    /// Takes the present pose, of which `upper` and `lower` are the bones' ways, as the next frame; one in
    /// which the hinge is nearly straight, or folded, tells nothing.
    void Add(const Vec3& upper, const Vec3& lower, const CNode& bone);
    /// The axis, a unit vector; none where the hinge hardly bends or bends about many axes.
    std::optional<Vec3> Axis() const;

private:
    Vec3 m_kSum = kVec3Zero;
    double m_fWeight = 0.0;
    int m_iFrames = 0;
};

} // namespace gw
