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

/// Measures the feet, hips, trunk and hands of a conversion frame by frame.
class CBodyMeter
{
public:
    /// Both trees must be posed.
    CBodyMeter(std::span<const BonePair> pairs, const CSourceTable& sources);

    void WatchJoints(CPoseSampler& source, CPoseSampler& result) const;
    /// Uses the current pose as the first frame's, to measure lengths and headings.
    void Begin();
    /// Adds the current pose as the next frame.
    void Add();
    /// Writes all figures except those of bones. Writes nothing without a leg, because lengths are compared
    /// in leg lengths. Call it once, after the last frame. `secondsPerFrame` is the source's. `detail`,
    /// unless null, receives the curves.
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
    /// Returns the number of result units per source unit.
    double SourceScale() const { return m_kResultFeet.LegLength() / m_kSourceFeet.LegLength(); }
    /// Returns the y of the source's floor.
    double SourceFloor() const;

    std::vector<LegPair> m_kLegs;
    std::array<BonePair, 2> m_kHands{};
    CFeetTrack m_kSourceFeet;
    CFeetTrack m_kResultFeet;
    CBodyTrack m_kSource; // in the result's size after the last frame
    CBodyTrack m_kResult;
};

} // namespace gw
