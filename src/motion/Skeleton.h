#pragma once

#include "CNode.h"

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

} // namespace gw
