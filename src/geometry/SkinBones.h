#pragma once

#include "CObject.h"

#include <unordered_map>
#include <unordered_set>

namespace gw {

class CSpatial;

/// Bones under a root by the names of others, to be asked often.
class CBonesByName
{
public:
    explicit CBonesByName(CObject& root) : root_(root) {}

    /// The first node that has a bone's name, derived classes included; null for no bone, a bone without a
    /// name and a name that is not there.
    CSpatial* Find(const CSpatial* bone);

private:
    CObject& root_;
    std::unordered_map<const CSpatial*, CSpatial*> m_kFound;
};

/// The copies that cloning has made, to be asked often.
class CCopies
{
public:
    explicit CCopies(const CCloneMap& map);
    bool Contains(const CObject* object) const { return m_kCopies.contains(object); }

private:
    std::unordered_set<const CObject*> m_kCopies;
};

} // namespace gw
