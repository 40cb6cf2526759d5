#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <vector>

namespace gw {

class CMotionFile;

/// World positions of a body's hip and feet in each frame, in the file's unit.
struct BodyPaths
{
    std::vector<Vec3> hip;
    std::array<std::vector<Vec3>, 2> feet; ///< ankles, by EBodySide

    size_t FrameCount() const { return hip.size(); }
};

/// Returns the paths of a body with a hip and both feet; empty for other bodies. Leaves the tree posed.
BodyPaths FollowBody(const CMotionFile& motion, const CBodyMap& body);

/// Returns the length of thigh plus shin in the rest pose, averaged over both legs; 0 if a joint is missing.
double RestLegLength(const CBodyMap& body);

} // namespace gw
