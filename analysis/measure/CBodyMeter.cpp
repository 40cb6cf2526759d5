#include "CBodyMeter.h"

#include "CNode.h"
#include "DetailCurves.h"
#include "Figures.h"
#include "FindPlants.h"
#include "HostBones.h"
#include "Landmarks.h"
#include "LegJitter.h"
#include "MeasureFoot.h"
#include "MeasureHands.h"
#include "MeasureTrunk.h"
#include "Series.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <utility>

namespace gw {

namespace {

constexpr double kLeastTravel = 500.0; // mm; a shorter path is only sway and noise
constexpr double kSinkShare = 0.05;    // deeper values in fewer frames than this are outliers

// A bad mapping can use a knee as its own ankle.
bool IsLength(double leg)
{
    return std::isfinite(leg) && leg > 0.0;
}

// A foot without a toe joint uses the heading of the other skeleton's foot.
void LendHeading(CLegTrack& source, CLegTrack& result)
{
    if (!result.HasToe())
        result.SetHeading(source.HasToe() ? source.Heading() : kVec3UnitZ);
    if (!source.HasToe())
        source.SetHeading(result.Heading());
}

double SinkDepth(const std::vector<CLegTrack>& legs)
{
    std::vector<float> lowest;
    for (size_t f = 0; !legs.empty() && f < legs[0].Postures().size(); ++f)
    {
        const auto height = [=](const CLegTrack& leg) { return leg.Postures()[f].soleHeight; };
        lowest.push_back(height(*std::ranges::min_element(legs, {}, height)));
    }
    return std::max(0.0, -static_cast<double>(Percentile(std::move(lowest), kSinkShare)));
}

std::optional<double> CommonF1(const std::vector<FootMeasures>& feet)
{
    size_t both = 0;
    size_t standing = 0;
    for (const FootMeasures& foot : feet)
    {
        both += foot.bothStanding;
        standing += foot.sourceStanding + foot.resultStanding;
    }
    return RatioOf(2.0 * static_cast<double>(both), static_cast<double>(standing));
}

// If the ankle is closer to its floor than this share of the leg length, the skeleton has no sole.
constexpr double kNoSole = 0.01;

// Returns how far the floor is below the source's soles if these are its ankles: as far as below the result's
// ankles, in leg lengths.
double DepthUnderSoles(const CFeetTrack& source, const CFeetTrack& result)
{
    if (source.Legs()[0].AnkleHeight() > kNoSole * source.LegLength())
        return 0.0;
    return result.Legs()[0].AnkleHeight() / result.LegLength() * source.LegLength();
}

// Returns the level on which the soles of a skeleton stand.
double SoleFloor(const std::vector<CLegTrack>& legs)
{
    std::vector<float> heights;
    for (const CLegTrack& leg : legs)
        std::ranges::transform(leg.Postures(), std::back_inserter(heights), &CLegTrack::Posture::soleHeight);
    return static_cast<double>(Percentile(std::move(heights), kFloorShare));
}

double PathOf(const CBodyTrack& body)
{
    CRunningMean steps;
    for (size_t f = 1; f < body.FrameCount(); ++f)
        steps.Add(GroundDistance(body.Hips(f - 1), body.Hips(f)));
    return steps.Sum();
}

} // namespace

CBodyMeter::CBodyMeter(std::span<const BonePair> pairs, const CSourceTable& sources)
    : m_kLegs(FindLegs(pairs, sources)), m_kSourceFeet(LegsOf(m_kLegs, &LegPair::source)),
      m_kResultFeet(LegsOf(m_kLegs, &LegPair::result)),
      m_kSource(LandmarksOf(pairs, m_kLegs, &LegPair::source, &BonePair::source)),
      m_kResult(LandmarksOf(pairs, m_kLegs, &LegPair::result, &BonePair::target))
{
    for (size_t i = 0; i < m_kHands.size(); ++i)
        m_kHands[i] = {Landmark(pairs, kHostSides[i].hand, &BonePair::target),
                       Landmark(pairs, kHostSides[i].hand, &BonePair::source)};
}

void CBodyMeter::WatchJoints(CPoseSampler& source, CPoseSampler& result) const
{
    m_kSourceFeet.WatchJoints(source);
    m_kResultFeet.WatchJoints(result);
    m_kSource.WatchJoints(source);
    m_kResult.WatchJoints(result);
}

void CBodyMeter::Begin()
{
    m_kSourceFeet.MeasureLegs();
    m_kResultFeet.MeasureLegs();
    for (size_t i = 0; i < m_kLegs.size(); ++i)
        LendHeading(m_kSourceFeet.Legs()[i], m_kResultFeet.Legs()[i]);
}

void CBodyMeter::Add()
{
    m_kSourceFeet.Append();
    m_kResultFeet.Append();
    m_kSource.Append();
    m_kResult.Append();
}

double CBodyMeter::SourceFloor() const
{
    return SoleFloor(m_kSourceFeet.Legs()) - DepthUnderSoles(m_kSourceFeet, m_kResultFeet);
}

void CBodyMeter::WriteFeet(ConversionMeasures& measures, double secondsPerFrame,
                           ConversionDetail* detail) const
{
    const LegPlants source = FindPlants(m_kSourceFeet, secondsPerFrame);
    const LegPlants result = FindPlants(m_kResultFeet, secondsPerFrame);
    std::vector<PlantSlide> ankleSlides;
    std::vector<PlantSlide> toeSlides;
    std::vector<float> heldSoles;
    for (size_t i = 0; i < m_kLegs.size(); ++i)
    {
        MeasuredFoot foot = MeasureFoot({m_kSourceFeet.Legs()[i], source[i], SourceScale()},
                                        {m_kResultFeet.Legs()[i], result[i], 1.0}, secondsPerFrame);
        foot.figures.target = m_kLegs[i].ankles.target->NameView();
        foot.figures.source = m_kLegs[i].ankles.source->NameView();
        measures.feet.push_back(std::move(foot.figures));
        std::ranges::copy(foot.ankleSlides, std::back_inserter(ankleSlides));
        std::ranges::copy(foot.toeSlides, std::back_inserter(toeSlides));
        std::ranges::copy(foot.heldSoles, std::back_inserter(heldSoles));
    }
    measures.ankleSlide = SummaryOf(ankleSlides);
    measures.toeSlide = SummaryOf(toeSlides);
    measures.contactF1 = CommonF1(measures.feet);
    if (!heldSoles.empty())
        measures.heldSole = static_cast<double>(Percentile(std::move(heldSoles), kMostShare));
    measures.sinkDepth = SinkDepth(m_kResultFeet.Legs());
    if (detail)
        WriteFeetDetail(*detail, source, result);
}

void CBodyMeter::WriteHips(ConversionMeasures& measures) const
{
    const double source = PathOf(m_kSource);
    const double result = PathOf(m_kResult);
    measures.sourceTravel = source / measures.resultLeg;
    measures.resultTravel = result / measures.resultLeg;
    measures.travelRatio = RatioOf(result, source, kLeastTravel);
}

void CBodyMeter::WriteTrunk(ConversionMeasures& measures, ConversionDetail* detail) const
{
    std::vector<float> errors = TrunkErrors(m_kSource, m_kResult);
    if (errors.empty())
        return;
    CRunningMean mean;
    for (size_t f = 0; f < errors.size(); ++f)
    {
        const auto error = static_cast<double>(errors[f]);
        if (error > mean.Largest())
            measures.trunkFrame = static_cast<int>(f);
        mean.Add(error);
    }
    measures.trunkMean = mean.Mean();
    measures.trunkLargest = mean.Largest();
    measures.trunkMost = static_cast<double>(Percentile(errors, kMostShare));
    if (detail)
        detail->trunkError = std::move(errors);
}

void CBodyMeter::WriteJitter(ConversionMeasures& measures, double secondsPerFrame) const
{
    std::vector<float> ratios = LegJitterRatios(m_kSource, m_kResult, secondsPerFrame);
    if (ratios.empty())
        return;
    measures.jitterRatioLargest = static_cast<double>(std::ranges::max(ratios));
    measures.jitterRatio = Median(std::move(ratios));
}

void CBodyMeter::WriteHands(ConversionMeasures& measures, double secondsPerFrame) const
{
    const HandSides sides{m_kSource, m_kResult, SourceFloor() * SourceScale(), secondsPerFrame};
    for (size_t side = 0; side < m_kHands.size(); ++side)
    {
        if (!m_kHands[side].target)
            continue;
        HandMeasures hand = MeasureHand(sides, side);
        hand.target = m_kHands[side].target->NameView();
        hand.source = m_kHands[side].source->NameView();
        if (hand.gap)
            measures.handGap = std::max(measures.handGap.value_or(0.0), *hand.gap);
        measures.handDepth = std::max(measures.handDepth.value_or(0.0), hand.depth);
        measures.hands.push_back(std::move(hand));
    }
}

void CBodyMeter::WriteFeetDetail(ConversionDetail& detail, const LegPlants& source,
                                 const LegPlants& result) const
{
    const double soleFloor = SoleFloor(m_kSourceFeet.Legs());
    detail.sourceFloor = SourceFloor();
    for (size_t i = 0; i < m_kLegs.size(); ++i)
    {
        const CLegTrack& from = m_kSourceFeet.Legs()[i];
        const CLegTrack& to = m_kResultFeet.Legs()[i];
        detail.feet.push_back({PostureCurve(from, &CLegTrack::Posture::soleHeight, soleFloor, SourceScale()),
                               PostureCurve(to, &CLegTrack::Posture::soleHeight),
                               PostureCurve(from, &CLegTrack::Posture::kneeAngle),
                               PostureCurve(to, &CLegTrack::Posture::kneeAngle), source[i].foot,
                               result[i].foot});
    }
}

void CBodyMeter::WriteHipsDetail(ConversionDetail& detail) const
{
    detail.sourceHips = HipsFromStart(m_kSource, SourceFloor() * SourceScale());
    detail.resultHips = HipsFromStart(m_kResult, 0.0);
}

void CBodyMeter::Write(ConversionMeasures& measures, double secondsPerFrame, ConversionDetail* detail)
{
    if (!IsLength(m_kSourceFeet.LegLength()) || !IsLength(m_kResultFeet.LegLength()))
        return;
    measures.sourceLeg = m_kSourceFeet.LegLength();
    measures.resultLeg = m_kResultFeet.LegLength();
    m_kSource.Scale(SourceScale());
    WriteFeet(measures, secondsPerFrame, detail);
    WriteHips(measures);
    WriteTrunk(measures, detail);
    WriteJitter(measures, secondsPerFrame);
    WriteHands(measures, secondsPerFrame);
    if (detail)
        WriteHipsDetail(*detail);
}

} // namespace gw
