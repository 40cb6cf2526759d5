#pragma once

#include "CNode.h"

#include <algorithm>
#include <string_view>
#include <vector>

namespace gw {

/// Returns the first node with a name at or below a root, or null.
inline CNode* FindNode(CNode* root, const char* name)
{
    return root ? static_cast<CNode*>(root->FindObject(name, &CNode::ms_kRTTI, true)) : nullptr;
}

/// Returns all nodes at or below a root, depth first.
inline std::vector<CNode*> NodesOf(CNode& root)
{
    std::vector<CObject*> found;
    root.FindObjects(found, nullptr, &CNode::ms_kRTTI, true);
    std::vector<CNode*> nodes;
    nodes.reserve(found.size());
    for (CObject* object : found)
        nodes.push_back(static_cast<CNode*>(object));
    return nodes;
}

/// Maps exact names to the nodes of a tree, for several look-ups while the tree does not change. Skeletons
/// have few nodes, while a search of the tree also visits everything attached to them.
class CNodeNames
{
public:
    explicit CNodeNames(CNode& root) : m_kNodes(NodesOf(root)) {}

    /// Returns the same as FindNode.
    CNode* Find(std::string_view name) const
    {
        const auto has = [=](const CNode* node) { return node->GetName() && node->NameView() == name; };
        const auto found = std::ranges::find_if(m_kNodes, has);
        return found == m_kNodes.end() ? nullptr : *found;
    }

private:
    std::vector<CNode*> m_kNodes;
};

} // namespace gw
