#pragma once

namespace gw {

class CNode;

/// Returns the node of a figure from which legs and trunk branch: the first one, down the largest branches,
/// with two or more branches of at least three nodes. In trees without such a node, the root.
CNode* FindHip(CNode& root);

} // namespace gw
