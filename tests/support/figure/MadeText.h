#pragma once

#include "Vec3.h"

#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A joint in the text of a BVH file. Joints come depth first; the first one is the root.
struct TextJoint
{
    std::string name;
    int parent = -1;
    Vec3 offset;
    Vec3 tip{0.0f, 6.0f, 0.0f}; ///< of a joint without children
    bool hasPositions = false;  ///< six channels; always true for the root
};

/// The values of a joint in a row.
struct TextKey
{
    Vec3 position;
    Vec3 degrees; ///< about X, Y and Z; written as rotations about Z, X and Y
};

/// Returns the text of a BVH file with that many frames; `key` is called once per frame and joint.
std::string MadeText(const std::vector<TextJoint>& joints, int frameCount, double frameSeconds,
                     const std::function<TextKey(size_t joint, int frame)>& key);

} // namespace gw
