#pragma once

#include "Text.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// Maps names to the bones of a skeleton, for many look-ups while the tree does not change. Nodes are not
/// kept alive.
class CBoneNames
{
public:
    /// Lists the bones below a root; a null root has no bones.
    explicit CBoneNames(CNode* root);

    CNode* Root() const { return m_pkRoot; }
    /// Returns the first node, in search order, with exactly this name, otherwise the first one that matches
    /// when ignoring case, or null. Nodes without a name are never found.
    CNode* Find(std::string_view name) const;
    /// Returns the distinct names, in search order.
    const std::vector<std::string>& Names() const { return m_kNames; }

private:
    // Both ignore case.
    struct Hash
    {
        size_t operator()(std::string_view name) const;
    };
    struct Equal
    {
        bool operator()(std::string_view a, std::string_view b) const { return EqualNoCase(a, b); }
    };
    using AnyCase = std::unordered_map<std::string_view, CNode*, Hash, Equal>;

    const AnyCase& NamesInAnyCase() const;

    CNode* m_pkRoot;
    // Views of the nodes' own names.
    std::unordered_map<std::string_view, CNode*> m_kExact;
    mutable AnyCase m_kAnyCase; // built when first needed
    std::vector<std::string> m_kNames;
};

/// Same for a single look-up.
CNode* FindBone(CNode* root, std::string_view name);

} // namespace gw
