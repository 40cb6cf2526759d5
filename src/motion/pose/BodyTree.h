#pragma once

#include <cstddef>
#include <vector>

namespace gw {

class CNode;

/// Returns whether a node is `ancestor` or below it. False for null.
bool IsAtOrBelow(const CNode* node, const CNode* ancestor);
/// Returns the number of nodes above a node.
size_t DepthOf(const CNode* node);
/// Returns the deepest node at or above both, or null.
CNode* CommonAncestor(CNode* a, CNode* b);
/// Returns the nodes strictly between a node and another below it, top down; empty if it is not below.
std::vector<CNode*> NodesBetween(const CNode* top, const CNode* bottom);
/// Returns the child nodes, in order.
std::vector<CNode*> ChildNodes(const CNode& node);
/// Returns the first child node, or null.
CNode* FirstChild(const CNode& node);

} // namespace gw
