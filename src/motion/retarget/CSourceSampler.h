#pragma once

#include <unordered_set>
#include <vector>

namespace gw {

class CNode;
class CSpatial;

/// Updates the source nodes that a conversion reads, their ancestors and their bone meshes to a time, each
/// once. The rest of the source (fingers, other meshes, bounds) is not updated.
class CSourceSampler
{
public:
    CSourceSampler(const CNode* root, const std::vector<CNode*>& wanted);

    /// Adds more nodes to update.
    void Add(const std::vector<CNode*>& wanted);
    void Sample(float time) const;

private:
    void Add(CNode& node);

    const CSpatial* m_pkRoot;
    std::unordered_set<const CSpatial*> m_kKnown;
    std::vector<CSpatial*> m_kOrder; // parents first
};

} // namespace gw
