#pragma once

#include "Vec3.h"

#include <cstdint>
#include <vector>

namespace gw {

/// A bone to be shown: from a joint to the end of its bone, both in the rest pose.
struct BoneBox
{
    uint16_t joint = 0;
    Vec3 from = kVec3Zero;
    Vec3 to = kVec3Zero;
};

/// Vertices with their normals and joints, and triangles as triples of vertex indices.
struct BoxMesh
{
    std::vector<float> positions;
    std::vector<float> normals;
    std::vector<uint16_t> joints;  ///< four per vertex; only the first has weight
    std::vector<float> weights;    ///< four per vertex
    std::vector<uint32_t> indices; ///< counterclockwise as seen from outside
};

/// Returns a box around each bone, a fifth as wide as the bone is long and no wider than `mostWidth`. Bones
/// without length are left out.
BoxMesh MakeBoneBoxes(const std::vector<BoneBox>& bones, float mostWidth);

} // namespace gw
