#pragma once

namespace gw {

class CObject;

/// Dresses the nodes of a loaded tree with bone meshes: balls where a node has more than one child slot, else
/// tapered bones that reach to the child along the dominant axis. Null has no nodes. Always true.
bool AttachBoneMeshes(CObject* root);

} // namespace gw
