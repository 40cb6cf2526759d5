#pragma once

#include "Mat4.h"

namespace gw {

class CBoneMesh;
class CNode;

/// A node's first child that is a bone mesh, or null.
CBoneMesh* FindBoneMesh(const CNode& node);
/// The length of that mesh, 0 without one.
float NodeBoneLength(const CNode& node);
/// The direction of the bone in the space of that mesh, kVec3Zero without one.
Vec3 NodeBoneAxis(const CNode& node);
/// The world matrix of that mesh, the node's own without one.
const Mat4& NodeBoneWorld(const CNode& node);

/// Where the bone of a node without children ends, in the node's space: as the file told it, else as that
/// mesh shows it. Zero without a mesh or a length.
Vec3 NodeBoneEnd(const CNode& node);

} // namespace gw
