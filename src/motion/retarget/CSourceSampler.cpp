#include "CSourceSampler.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"

namespace gw {

CSourceSampler::CSourceSampler(const CNode* root, const std::vector<CNode*>& wanted) : m_pkRoot(root)
{
    Add(wanted);
}

void CSourceSampler::Add(const std::vector<CNode*>& wanted)
{
    for (CNode* node : wanted)
        Add(*node);
}

void CSourceSampler::Add(CNode& node)
{
    std::vector<CSpatial*> path;
    for (CSpatial* spatial = &node; spatial && m_kKnown.insert(spatial).second;
         spatial = spatial->GetParent())
    {
        path.push_back(spatial);
        if (spatial == m_pkRoot)
            break;
    }
    m_kOrder.insert(m_kOrder.end(), path.rbegin(), path.rend());
    if (CBoneMesh* mesh = FindBoneMesh(node); mesh && m_kKnown.insert(mesh).second)
        m_kOrder.push_back(mesh);
}

void CSourceSampler::Sample(float time) const
{
    for (CSpatial* spatial : m_kOrder)
        spatial->CSpatial::UpdateTransform(time);
}

} // namespace gw
