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
    m_kFeet.AppendPlaces();
    m_kRoots.push_back(m_pkRoot ? m_pkRoot->m_kWorldMatrix.Translation() : kVec3Zero);
    Vec3 hips = kVec3Zero;
    for (const LegJoints& leg : m_kLegs)
        hips = hips + leg.thigh->m_kWorldMatrix.Translation() * (1.0f / static_cast<float>(m_kLegs.size()));
    m_kHips.push_back(hips);
}

bool CSourceBody::HasLegs() const
{
    return LegLength() > 0.0 && std::isfinite(LegLength());
}

std::vector<std::vector<Contact>> CSourceBody::Contacts(double secondsPerFrame) const
{
    return HasLegs() ? m_kFeet.Contacts(secondsPerFrame) : std::vector<std::vector<Contact>>(m_kLegs.size());
}

std::vector<FootTouches> CSourceBody::Touches(double secondsPerFrame) const
{
    if (HasLegs())
        return m_kFeet.Touches(secondsPerFrame);
    return std::vector<FootTouches>(m_kLegs.size(), {{}, std::vector<float>(FrameCount(), 0.0f)});
}

} // namespace gw
