#include "FindBone.h"

#include "CNode.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

std::vector<CObject*> NodesBelow(CNode* root)
{
    std::vector<CObject*> nodes;
    if (root)
        root->FindObjects(nodes, nullptr, &CNode::ms_kRTTI, true);
    return nodes;
}

} // namespace

CBoneNames::CBoneNames(CNode* root)
{
    for (CObject* object : NodesBelow(root))
    {
        if (!object->GetName())
            continue;
        const std::string_view name = object->NameView();
        CNode* node = static_cast<CNode*>(object);
        if (m_kExact.try_emplace(name, node).second)
            m_kNames.emplace_back(name);
    }
}

CNode* CBoneNames::Find(std::string_view name) const
{
    const auto exact = m_kExact.find(name);
    if (exact != m_kExact.end())
        return exact->second;
    const auto lower = LowerCaseNames().find(LowerCase(name));
    return lower == m_kLowerCase.end() ? nullptr : lower->second;
}

// Most look-ups match exactly, so this table is built only when one does not.
const std::unordered_map<std::string, CNode*>& CBoneNames::LowerCaseNames() const
{
    if (m_kLowerCase.empty())
    {
        for (const std::string& name : m_kNames)
            m_kLowerCase.try_emplace(LowerCase(name), m_kExact.at(name)); // the first of equal names wins
    }
    return m_kLowerCase;
}

CNode* FindBone(CNode* root, std::string_view name)
{
    const std::vector<CObject*> nodes = NodesBelow(root);
    const auto has = [&](const CObject* node) { return node->GetName() && node->NameView() == name; };
    const auto hasAnyCase = [&](const CObject* node) {
        return node->GetName() && EqualNoCase(node->NameView(), name);
    };
    auto found = std::ranges::find_if(nodes, has);
    if (found == nodes.end())
        found = std::ranges::find_if(nodes, hasAnyCase);
    return found == nodes.end() ? nullptr : static_cast<CNode*>(*found);
}

} // namespace gw
