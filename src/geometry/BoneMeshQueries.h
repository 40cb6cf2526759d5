#pragma once

#include "Mat4.h"

namespace gw {

class CBoneMesh;
class CNode;

/// Returns a node's first child that is a bone mesh, or null.
CBoneMesh* FindBoneMesh(const CNode& node);
/// Returns the length of that mesh, or 0 without one.
float NodeBoneLength(const CNode& node);
/// Returns the direction of the bone in the mesh's space, or kVec3Zero without one.
Vec3 NodeBoneAxis(const CNode& node);
/// Returns the world matrix of that mesh, or the node's own without one.
const Mat4& NodeBoneWorld(const CNode& node);

/// Returns the end of the bone of a node without children, in the node's space: as stored in the file,
/// otherwise as that mesh shows it. Zero without a mesh or a length.
Vec3 NodeBoneEnd(const CNode& node);

} // namespace gw
