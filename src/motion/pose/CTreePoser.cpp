#include "CTreePoser.h"

namespace gw {

CTreePoser::CTreePoser(std::vector<CNode*> joints, float frequency)
    : m_kJoints(std::move(joints)), m_kSampler(frequency)
{
    for (CNode* joint : m_kJoints)
    {
        m_kIndex.emplace(joint, static_cast<int>(m_kIndex.size()));
        m_kSampler.Watch(joint);
    }
}

int CTreePoser::IndexOf(const CNode* joint) const
{
    const auto found = m_kIndex.find(joint);
    return found == m_kIndex.end() ? -1 : found->second;
}

void CTreePoser::PoseRest()
{
    for (CNode* joint : m_kJoints)
    {
        const CNode* const parent = joint->GetParentNode();
        const Mat4& local = RestLocal(*joint);
        joint->m_kWorldMatrix = parent ? local * parent->m_kWorldMatrix : local;
    }
}

} // namespace gw
