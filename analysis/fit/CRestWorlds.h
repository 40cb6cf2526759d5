#pragma once

#include "CPoseSampler.h"
#include "Mat4.h"

#include <unordered_map>

namespace gw {

/// World matrices of nodes in their trees' rest poses, each computed once. The maps of one rig ask for the
/// same nodes again and again.
class CRestWorlds
{
public:
    /// Returns RestWorld of a node. The trees must not change.
    const Mat4& Of(const CNode& node)
    {
        const auto [world, isNew] = m_kWorlds.try_emplace(&node);
        if (isNew)
            world->second = RestWorld(node);
        return world->second;
    }

private:
    std::unordered_map<const CNode*, Mat4> m_kWorlds;
};

} // namespace gw
