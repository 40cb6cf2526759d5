#pragma once

#include "CSceneNodes.h"

#include <cstddef>
#include <vector>

namespace gw {

/// A skeleton found among the nodes of a scene.
struct SceneSkeleton
{
    std::vector<size_t> nodes; ///< index of each joint's node, parents first; empty if no skeleton was found
    std::vector<int> parents;  ///< index of each joint's parent among the joints; -1 for the first
};

/// Finds the skeleton of a scene: the bones of its skins, or else the nodes that its clips move.
SceneSkeleton FindSkeleton(const CSceneNodes& nodes);

} // namespace gw
