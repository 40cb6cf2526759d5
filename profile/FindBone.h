#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// The bones of a skeleton by name, for many look-ups in a tree that does not change meanwhile. The nodes are
/// looked at and not kept alive.
class CBoneNames
{
public:
    /// A null root has no bones.
    explicit CBoneNames(CNode* root);

    /// The first node with exactly this name in search order, else the first one that equals it without
    /// regard to case, or null. Nodes without a name are never found.
    CNode* Find(std::string_view name) const;
    /// The distinct names, in search order.
    const std::vector<std::string>& Names() const { return m_kNames; }

private:
    using NodeOfName = std::unordered_map<std::string, CNode*>;

    const NodeOfName& LowerCaseNames() const;

    NodeOfName m_kExact;
    mutable NodeOfName m_kLowerCase; ///< empty until it is asked for
    std::vector<std::string> m_kNames;
};

/// The same for a single look-up.
CNode* FindBone(CNode* root, std::string_view name);

} // namespace gw
