#include "CBodyTrack.h"

#include "BodyPose.h"
#include "CPoseSampler.h"

namespace gw {

namespace {

void AppendPlace(std::vector<Vec3>& places, const CNode* joint)
{
    if (joint)
        places.push_back(PlaceOf(*joint));
}

TrunkLine TrunkFrom(const Vec3& firstHip, const Vec3& lastHip, const Vec3& neck)
{
    return {neck - (firstHip + lastHip) * 0.5f, firstHip - lastHip};
}

} // namespace

CBodyTrack::CBodyTrack(BodyLandmarks joints) : m_kJoints(std::move(joints)), m_kLegs(m_kJoints.legs.size()) {}

void CBodyTrack::WatchJoints(CPoseSampler& sampler) const
{
    for (const LegJoints& leg : m_kJoints.legs)
    {
        for (CNode* joint : {leg.thigh, leg.knee, leg.ankle})
            sampler.Watch(joint);
    }
    for (CNode* joint : {m_kJoints.neck, m_kJoints.head, m_kJoints.hands[0], m_kJoints.hands[1]})
        sampler.Watch(joint);
}

void CBodyTrack::Append()
{
    for (size_t i = 0; i < m_kLegs.size(); ++i)
    {
        AppendPlace(m_kLegs[i].hip, m_kJoints.legs[i].thigh);
        AppendPlace(m_kLegs[i].knee, m_kJoints.legs[i].knee);
        AppendPlace(m_kLegs[i].ankle, m_kJoints.legs[i].ankle);
    }
    AppendPlace(m_kNeck, m_kJoints.neck);
    AppendPlace(m_kHead, m_kJoints.head);
    for (size_t side = 0; side < m_kHands.size(); ++side)
        AppendPlace(m_kHands[side], m_kJoints.hands[side]);
}

void CBodyTrack::Scale(double factor)
{
    const auto scale = [factor](std::vector<Vec3>& places) {
        for (Vec3& place : places)
            place = place * static_cast<float>(factor);
    };
    for (Leg& leg : m_kLegs)
    {
        scale(leg.hip);
        scale(leg.knee);
        scale(leg.ankle);
    }
    for (std::vector<Vec3>* places : {&m_kNeck, &m_kHead, &m_kHands[0], &m_kHands[1]})
        scale(*places);
}

Vec3 CBodyTrack::Hips(size_t frame) const
{
    return (m_kLegs.front().hip[frame] + m_kLegs.back().hip[frame]) * 0.5f;
}

TrunkLine CBodyTrack::Trunk(size_t frame) const
{
    return TrunkFrom(m_kLegs.front().hip[frame], m_kLegs.back().hip[frame], m_kNeck[frame]);
}

TrunkLine CBodyTrack::RestTrunk() const
{
    const auto place = [](const CNode& joint) { return RestWorld(joint).Translation(); };
    return TrunkFrom(place(*m_kJoints.legs.front().thigh), place(*m_kJoints.legs.back().thigh),
                     place(*m_kJoints.neck));
}

} // namespace gw
