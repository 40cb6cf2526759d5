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
        if (m_kExact.try_emplace(std::string(name), node).second)
            m_kNames.emplace_back(name);
        m_kLowerCase.try_emplace(LowerCase(name), node); // the first of equal names stays
    }
}

CNode* CBoneNames::Find(std::string_view name) const
{
    const auto exact = m_kExact.find(std::string(name));
    if (exact != m_kExact.end())
        return exact->second;
    const auto lower = m_kLowerCase.find(LowerCase(name));
    return lower == m_kLowerCase.end() ? nullptr : lower->second;
}

CNode* FindBone(CNode* root, std::string_view name)
{
    return CBoneNames(root).Find(name);
}

} // namespace gw
