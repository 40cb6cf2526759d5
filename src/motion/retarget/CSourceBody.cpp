#include "CSourceBody.h"

#include "CNode.h"
#include "Figures.h"

#include <cmath>

namespace gw {

namespace {

// A foot that stands rolls over its ball more often than over its heel.
constexpr double kFlatShare = 0.25;

} // namespace

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

float CSourceBody::FlatDrop(double secondsPerFrame) const
{
    std::vector<float> drops;
    const std::vector<std::vector<Contact>> contacts = Contacts(secondsPerFrame);
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
    {
        const CLegTrack& track = Leg(leg);
        if (!track.HasToe())
            continue;
        for (const Contact& contact : contacts[leg])
        {
            for (auto frame = static_cast<size_t>(contact.first); frame < static_cast<size_t>(contact.end);
                 ++frame)
                drops.push_back(track.Ankles()[frame].y - track.Toes()[frame].y);
        }
    }
    if (drops.empty())
        return FloorOf(m_kFeet.Legs(), &CLegTrack::Ankles) - FloorOf(m_kFeet.Legs(), &CLegTrack::Toes);
    return Percentile(std::move(drops), kFlatShare);
}

} // namespace gw
