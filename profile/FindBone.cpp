#include "FindBone.h"

#include "CNode.h"
#include "Text.h"

#include <algorithm>
#include <cstdint>

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

CBoneNames::CBoneNames(CNode* root) : m_pkRoot(root)
{
    const std::vector<CObject*> nodes = NodesBelow(root);
    m_kExact.reserve(nodes.size());
    m_kNames.reserve(nodes.size());
    for (CObject* object : nodes)
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
    const AnyCase& names = NamesInAnyCase();
    const auto found = names.find(name);
    return found == names.end() ? nullptr : found->second;
}

// Most look-ups match exactly, so this table is built only when one does not.
const CBoneNames::AnyCase& CBoneNames::NamesInAnyCase() const
{
    if (m_kAnyCase.empty())
    {
        m_kAnyCase.reserve(m_kNames.size());
        for (const std::string& name : m_kNames)
            m_kAnyCase.insert(*m_kExact.find(name)); // the first of equal names wins
    }
    return m_kAnyCase;
}

// The hash of Fowler, Noll and Vo. A letter and its capital differ only in the bit that is set here.
size_t CBoneNames::Hash::operator()(std::string_view name) const
{
    uint64_t hash = 0xcbf29ce484222325;
    for (const char c : name)
        hash = (hash ^ (static_cast<unsigned char>(c) | 0x20u)) * 0x100000001b3;
    return hash;
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
