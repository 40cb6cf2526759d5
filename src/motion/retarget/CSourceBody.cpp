#include "CSourceBody.h"

#include "CNode.h"

#include <cmath>

namespace gw {

CSourceBody::CSourceBody(const CNode* root, const std::vector<LegJoints>& legs)
    : m_pkRoot(root), m_kLegs(legs), m_kFeet(legs)
{
}

std::vector<CNode*> CSourceBody::Joints() const
{
    std::vector<CNode*> joints;
    for (const LegJoints& leg : m_kLegs)
    {
        for (CNode* joint : {leg.thigh, leg.knee, leg.ankle, leg.toe})
        {
            if (joint)
                joints.push_back(joint);
        }
    }
    return joints;
}

void CSourceBody::Append()
{
    if (m_kRoots.empty())
        m_kFeet.MeasureLegs();
    m_kFeet.Append();
    m_kRoots.push_back(m_pkRoot ? m_pkRoot->m_kWorldMatrix.Translation() : kVec3Zero);
    Vec3 hips = kVec3Zero;
    for (const LegJoints& leg : m_kLegs)
        hips = hips + leg.thigh->m_kWorldMatrix.Translation() * (1.0f / static_cast<float>(m_kLegs.size()));
    m_kHips.push_back(hips);
}

std::vector<std::vector<Contact>> CSourceBody::Contacts(double secondsPerFrame) const
{
    if (!(LegLength() > 0.0) || !std::isfinite(LegLength()))
        return std::vector<std::vector<Contact>>(m_kLegs.size());
    return m_kFeet.Contacts(secondsPerFrame);
}

} // namespace gw
