#pragma once

#include "CBodyMap.h"
#include "CNode.h"

namespace gw {

/// The posed body that defines the bones' rotations, and the axes of its stance.
struct CReferencePose
{
    /// Captures the current pose of the body's tree.
    CReferencePose(const CBodyMap& body, const Vec3& upAxis);

    Vec3 up;     ///< unit vector
    Vec3 facing; ///< horizontal unit vector, by the hips
    Mat3 hips;   ///< rotates the hips' heading to +Z and up to +Y
    Mat3 trunk;  ///< same by the shoulders; equals `hips` without them
    double legLength;
};

/// Joints closer together than this share of a leg are at the same place.
inline constexpr double kApart = 0.005;

/// Returns the vector along a joint's bone in the current pose: to the first joint below that is `apart` from
/// it, otherwise to the bone's end. Zero if there is neither.
Vec3 ReachOf(const CNode& joint, double apart);

} // namespace gw
