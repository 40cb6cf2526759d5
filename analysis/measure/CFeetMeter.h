#pragma once

#include "CFeetTrack.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "Legs.h"

#include <vector>

namespace gw {

class CPoseSampler;

/// The feet of a conversion while frames go by.
class CFeetMeter
{
public:
    /// Both trees are posed.
    explicit CFeetMeter(std::vector<LegPair> legs);

    void WatchJoints(CPoseSampler& source, CPoseSampler& result) const;
    /// Takes the present pose as that of the first frame for lengths and headings.
    void Begin();
    /// Takes the present pose as the next frame.
    void Add();
    double SourceLeg() const { return m_kSource.LegLength(); }
    double ResultLeg() const { return m_kResult.LegLength(); }
    /// Enters all figures of legs and ground. `secondsPerFrame` is the source's. `detail`, where there is
    /// one, takes the curves.
    void Write(ConversionMeasures& measures, double secondsPerFrame, ConversionDetail* detail) const;

private:
    using LegContacts = std::vector<std::vector<Contact>>;
    void WriteDetail(ConversionDetail& detail, const LegContacts& source, const LegContacts& result) const;

    std::vector<LegPair> m_kPairs;
    CFeetTrack m_kSource;
    CFeetTrack m_kResult;
};

} // namespace gw
