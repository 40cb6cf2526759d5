#pragma once

#include "CLegTrack.h"
#include "FindContacts.h"

#include <vector>

namespace gw {

class CPoseSampler;

/// The feet of one skeleton while frames go by.
class CFeetTrack
{
public:
    explicit CFeetTrack(const std::vector<LegJoints>& legs);

    void WatchJoints(CPoseSampler& sampler) const;
    /// Takes the present pose as the next frame.
    void Append();
    /// Takes the present pose for how long the legs are.
    void MeasureLegs();

    std::vector<CLegTrack>& Legs() { return m_kLegs; }
    const std::vector<CLegTrack>& Legs() const { return m_kLegs; }
    /// The legs' mean length, or 0 without legs.
    double LegLength() const { return m_fLegLength; }
    /// The contacts of each leg.
    std::vector<std::vector<Contact>> Contacts(double secondsPerFrame) const;

private:
    std::vector<CLegTrack> m_kLegs;
    double m_fLegLength = 0.0;
};

} // namespace gw
