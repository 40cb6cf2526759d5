#pragma once

#include "CEyeSpace.h"
#include "Ref.h"

#include <span>
#include <string>

namespace gw {

class CTriMesh;

/// A position in a view and the view's size, in the same unit.
struct ViewPosition
{
    double x;
    double y; ///< from the top
    double width;
    double height;
};

/// Returns the name of the bone whose mesh is drawn closest to a position, or empty if none is within a few
/// pixels. A bone without a shape is found at its joint.
std::string PickBone(std::span<const Ref<CTriMesh>> meshes, const CEyeSpace& space, const ViewPosition& at);

} // namespace gw
