#include "BodyTree.h"

#include "CNode.h"

#include <algorithm>

namespace gw {

bool IsAtOrBelow(const CNode* node, const CNode* ancestor)
{
    while (node && node != ancestor)
        node = node->GetParentNode();
    return node && ancestor;
}

size_t DepthOf(const CNode* node)
{
    size_t depth = 0;
    while ((node = node ? node->GetParentNode() : nullptr))
        ++depth;
    return depth;
}

CNode* CommonAncestor(CNode* a, CNode* b)
{
    size_t depthA = DepthOf(a);
    size_t depthB = DepthOf(b);
    while (a && b && a != b)
    {
        CNode*& deeper = depthA >= depthB ? a : b;
        --(depthA >= depthB ? depthA : depthB);
        deeper = deeper->GetParentNode();
    }
    return a == b ? a : nullptr;
}

std::vector<CNode*> NodesBetween(const CNode* top, const CNode* bottom)
{
    std::vector<CNode*> nodes;
    for (CNode* node = bottom ? bottom->GetParentNode() : nullptr; node != top; node = node->GetParentNode())
    {
        if (!node)
            return {};
        nodes.push_back(node);
    }
    std::ranges::reverse(nodes);
    return nodes;
}

std::vector<CNode*> ChildNodes(const CNode& node)
{
    std::vector<CNode*> children;
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            children.push_back(child);
    }
    return children;
}

CNode* FirstChild(const CNode& node)
{
    const std::vector<CNode*> children = ChildNodes(node);
    return children.empty() ? nullptr : children.front();
}

} // namespace gw
