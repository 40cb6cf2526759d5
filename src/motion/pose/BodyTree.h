#pragma once

#include <cstddef>
#include <vector>

namespace gw {

class CNode;

/// Whether a node is another one or below it. Null is below nothing.
bool IsAtOrBelow(const CNode* node, const CNode* ancestor);
/// The number of nodes above a node.
size_t DepthOf(const CNode* node);
/// The deepest node that is at or above both, or null.
CNode* CommonAncestor(CNode* a, CNode* b);
/// The nodes strictly between one and a node below it, downward; none where it is not below.
std::vector<CNode*> NodesBetween(const CNode* top, const CNode* bottom);
/// The child nodes of a node, in order.
std::vector<CNode*> ChildNodes(const CNode& node);
/// The first of them, or null.
CNode* FirstChild(const CNode& node);

} // namespace gw
