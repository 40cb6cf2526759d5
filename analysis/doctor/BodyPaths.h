#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <vector>

namespace gw {

class CMotionFile;

/// Where a body's hip and feet are in each frame, in world space and units of the file.
struct BodyPaths
{
    std::vector<Vec3> hip;
    std::array<std::vector<Vec3>, 2> feet; ///< the ankles, by EBodySide

    size_t FrameCount() const { return hip.size(); }
};

/// The paths of a body with a hip and both feet; none for one without. Leaves the tree posed.
BodyPaths FollowBody(const CMotionFile& motion, const CBodyMap& body);

/// The world axis, plus or minus, along which the hip is above the feet over the whole motion; +Y for a
/// motion without frames.
Vec3 FindUpAxis(const BodyPaths& paths);

/// Thigh and shin in the rest pose, the mean of both legs; 0 where a joint of them is not known.
double RestLegLength(const CBodyMap& body);

} // namespace gw
