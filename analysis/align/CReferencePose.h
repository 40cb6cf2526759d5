#pragma once

#include "CBodyMap.h"
#include "CNode.h"

namespace gw {

/// The posed body that tells how bones are turned, and the axes of its stance.
struct CReferencePose
{
    /// Takes the present pose of the body's tree.
    CReferencePose(const CBodyMap& body, const Vec3& upAxis);

    Vec3 up;     ///< unit vector
    Vec3 facing; ///< unit vector, level, by the hips
    Mat3 hips;   ///< turns the hips' heading to +Z and up to +Y
    Mat3 trunk;  ///< the same by the shoulders; that of the hips where there are none
    double legLength;
};

/// Joints that are nearer to each other than this share of a leg stand at one place.
inline constexpr double kApart = 0.005;

/// Where the bone of a joint leads in the present pose: to the first joint below that lies apart by a
/// length, else to the bone's end. Zero where there is neither.
Vec3 ReachOf(const CNode& joint, double apart);

} // namespace gw
