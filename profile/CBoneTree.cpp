#include "CBoneTree.h"

#include "CNode.h"
#include "Text.h"

namespace gw {

void CBoneTree::Rebuild(CNode* root)
{
    m_kItems.clear();
    m_kRootItems.clear();
    m_kByName.clear();
    m_iSelected = kNone;
    if (!root)
        return;
    std::vector<CObject*> nodes;
    root->FindObjects(nodes, nullptr, &CNode::ms_kRTTI, true);
    for (CObject* node : nodes)
    {
        // By name, not by node: children of a bone whose name was taken are attached to the item with that
        // name.
        const CSpatial* parent = static_cast<CNode*>(node)->GetParent();
        if (node->GetName())
            Add(node->NameView(), parent && parent->GetName() ? Find(parent->NameView()) : kNone);
    }
}

void CBoneTree::Add(std::string_view name, int parent)
{
    const int item = static_cast<int>(m_kItems.size());
    if (!m_kByName.try_emplace(LowerCase(name), item).second)
        return;
    m_kItems.push_back({std::string(name), parent, {}, false});
    (Has(parent) ? m_kItems[Index(parent)].m_kChildren : m_kRootItems).push_back(item);
}

// Names are distinct, so a look-up finds the same as a search of the tree.
int CBoneTree::Find(std::string_view name) const
{
    const auto found = m_kByName.find(LowerCase(name));
    return found == m_kByName.end() ? kNone : found->second;
}

void CBoneTree::Mark(int item, bool mapped)
{
    if (Has(item))
        m_kItems[Index(item)].m_bMapped = mapped;
}

const std::string& CBoneTree::Text(int item) const
{
    static const std::string kNoText;
    return Has(item) ? m_kItems[Index(item)].m_kText : kNoText;
}

} // namespace gw
