#pragma once

#include "CObject.h"

#include <unordered_map>
#include <unordered_set>

namespace gw {

class CSpatial;

/// Finds bones under a root by the names of other bones, for repeated queries.
class CBonesByName
{
public:
    explicit CBonesByName(CObject& root) : root_(root) {}

    /// Returns the first node with a bone's name, derived classes included; null if the bone is null or
    /// unnamed, or the name is not found.
    CSpatial* Find(const CSpatial* bone);

private:
    CObject& root_;
    std::unordered_map<const CSpatial*, CSpatial*> m_kFound;
};

/// Finds the copies that cloning has made, for repeated queries.
class CCopies
{
public:
    explicit CCopies(const CCloneMap& map);
    bool Contains(const CObject* object) const { return m_kCopies.contains(object); }

private:
    std::unordered_set<const CObject*> m_kCopies;
};

} // namespace gw
