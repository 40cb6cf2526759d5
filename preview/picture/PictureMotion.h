#pragma once

#include "CNode.h"

#include <cstdint>
#include <string>
#include <unordered_map>

namespace gw {

/// How a bone is drawn.
enum class EPictureSide : uint8_t
{
    Middle,
    Left,
    Right,
    Hidden, ///< not at all; neither is the line to it
};

/// A motion to be shown: its tree and its timing.
struct PictureMotion
{
    Ref<CNode> root; ///< null shows nothing
    float frameStep = 0.0f;
    float lastFrame = 0.0f;
    std::string label = {}; ///< shown above the figure
    /// The sides of nodes; others are in the middle.
    std::unordered_map<const CNode*, EPictureSide> sides = {};
    /// The two joints that show which way the figure faces; null faces along z.
    const CNode* leftHip = nullptr;
    const CNode* rightHip = nullptr;
    Vec3 up = kVec3UnitY; ///< the axis that is turned upright; positive or negative
};

} // namespace gw
