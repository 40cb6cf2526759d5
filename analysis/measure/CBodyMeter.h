#pragma once

#include "BonePairs.h"
#include "CBodyTrack.h"
#include "CFeetTrack.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "Legs.h"

#include <array>
#include <span>
#include <vector>

namespace gw {

class CPoseSampler;
struct FootPlants;

/// Feet, hips, trunk and hands of a conversion while frames go by.
class CBodyMeter
{
public:
    /// Both trees are posed.
    CBodyMeter(std::span<const BonePair> pairs, const CSourceTable& sources);

    void WatchJoints(CPoseSampler& source, CPoseSampler& result) const;
    /// Takes the present pose as that of the first frame for lengths and headings.
    void Begin();
    /// Takes the present pose as the next frame.
    void Add();
    /// Enters all figures but those of bones; none without a leg, as lengths are compared in legs. To be
    /// called once, at the end. `secondsPerFrame` is the source's. `detail`, where there is one, takes the
    /// curves.
    void Write(ConversionMeasures& measures, double secondsPerFrame, ConversionDetail* detail);

private:
    using LegPlants = std::vector<FootPlants>;
    void WriteFeet(ConversionMeasures& measures, double secondsPerFrame, ConversionDetail* detail) const;
    void WriteHips(ConversionMeasures& measures) const;
    void WriteTrunk(ConversionMeasures& measures, ConversionDetail* detail) const;
    void WriteJitter(ConversionMeasures& measures, double secondsPerFrame) const;
    void WriteHands(ConversionMeasures& measures, double secondsPerFrame) const;
    void WriteFeetDetail(ConversionDetail& detail, const LegPlants& source, const LegPlants& result) const;
    void WriteHipsDetail(ConversionDetail& detail) const;
    /// How many units of the result are one of the source.
    double SourceScale() const { return m_kResultFeet.LegLength() / m_kSourceFeet.LegLength(); }
    /// y on which the source stands.
    double SourceFloor() const;

    std::vector<LegPair> m_kLegs;
    std::array<BonePair, 2> m_kHands{};
    CFeetTrack m_kSourceFeet;
    CFeetTrack m_kResultFeet;
    CBodyTrack m_kSource; // in the result's size once it is complete
    CBodyTrack m_kResult;
};

} // namespace gw
