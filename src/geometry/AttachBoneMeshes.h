#pragma once

namespace gw {

class CObject;

/// Attaches bone meshes to the nodes of a loaded tree: balls to nodes with more than one child slot,
/// otherwise tapered bones that reach to the child along the dominant axis. `root` may be null. Always
/// returns true.
bool AttachBoneMeshes(CObject* root);

} // namespace gw
