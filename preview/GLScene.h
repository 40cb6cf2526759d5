#pragma once

#include "CDrawList.h"
#include "Vec3.h"

#include <span>

namespace gw {

class CGLView;

inline constexpr double kAngleOfView = 45.0; ///< degrees, from the lower side of a view to the upper one

/// What a view shows, as plain values: lines in world space, and from where they are seen.
struct GLScene
{
    std::span<const LineEnd> ends; ///< two for each line
    Vec3 pan;                      ///< of the whole scene, in the camera's space
    Vec3 eye;
    Vec3 lookAt;
    Vec3 up;
};

/// The scene of a view as it was evaluated last; its lines are valid until the view draws again.
GLScene SceneOf(CGLView& view);

} // namespace gw
