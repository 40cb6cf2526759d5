#pragma once

#include "CNode.h"

#include <algorithm>
#include <string_view>
#include <vector>

namespace gw {

/// The first node of a name under a root, itself included, or null.
inline CNode* FindNode(CNode* root, const char* name)
{
    return root ? static_cast<CNode*>(root->FindObject(name, &CNode::ms_kRTTI, true)) : nullptr;
}

/// All nodes under a root, itself included, depth first.
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

/// The nodes of a tree by their exact names, for several look-ups while the tree does not change. Bodies have
/// few nodes; a search of the tree looks at everything that hangs on them as well.
class CNodeNames
{
public:
    explicit CNodeNames(CNode& root) : m_kNodes(NodesOf(root)) {}

    /// What FindNode returns.
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
