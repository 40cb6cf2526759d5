#pragma once

#include "CDrawList.h"
#include "Vec3.h"

#include <span>

namespace gw {

class CGLView;

inline constexpr double kAngleOfView = 45.0; ///< in degrees, vertical

/// The content of a view as plain values: lines in world space, and the camera.
struct GLScene
{
    std::span<const LineEnd> ends; ///< two per line
    Vec3 pan;                      ///< of the whole scene, in camera space
    Vec3 eye;
    Vec3 lookAt;
    Vec3 up;
};

/// Returns a view's scene in its current state; its lines are valid until the view draws again.
GLScene SceneOf(CGLView& view);

} // namespace gw
