#include "CFeetTrack.h"

#include "CPoseSampler.h"
#include "Figures.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

// The height on which a joint of all feet stands.
float FloorOf(const std::vector<CLegTrack>& legs, const std::vector<Vec3>& (CLegTrack::*joint)() const)
{
    std::vector<float> heights;
    for (const CLegTrack& leg : legs)
        std::ranges::transform((leg.*joint)(), std::back_inserter(heights), &Vec3::y);
    return Percentile(std::move(heights), kFloorShare);
}

} // namespace

CFeetTrack::CFeetTrack(const std::vector<LegJoints>& legs)
{
    const double floor = RestFloor(legs);
    for (const LegJoints& leg : legs)
        m_kLegs.emplace_back(leg, floor);
}

void CFeetTrack::WatchJoints(CPoseSampler& sampler) const
{
    for (const CLegTrack& leg : m_kLegs)
        leg.WatchJoints(sampler);
}

void CFeetTrack::Append()
{
    for (CLegTrack& leg : m_kLegs)
        leg.Append();
}

void CFeetTrack::MeasureLegs()
{
    CRunningMean lengths;
    for (const CLegTrack& leg : m_kLegs)
        lengths.Add(leg.Length());
    m_fLegLength = lengths.Mean();
}

std::vector<std::vector<Contact>> CFeetTrack::Contacts(double secondsPerFrame) const
{
    const float ankleFloor = FloorOf(m_kLegs, &CLegTrack::Ankles);
    const float toeFloor = FloorOf(m_kLegs, &CLegTrack::Toes);
    std::vector<std::vector<Contact>> contacts;
    for (const CLegTrack& leg : m_kLegs)
    {
        std::vector<FloorPath> joints{
            {leg.Ankles(), ankleFloor}
        };
        if (leg.HasToe())
            joints.push_back({leg.Toes(), toeFloor});
        contacts.push_back(FindContacts(joints, m_fLegLength, secondsPerFrame));
    }
    return contacts;
}

} // namespace gw
