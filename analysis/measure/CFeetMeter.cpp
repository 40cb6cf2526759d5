#include "CFeetMeter.h"

#include "CNode.h"
#include "Figures.h"
#include "MeasureFoot.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

constexpr double kMedian = 0.5;
constexpr double kSinkShare = 0.05; // what sinks deeper in fewer frames is an outlier

std::vector<LegJoints> LegsOf(const std::vector<LegPair>& pairs, LegJoints LegPair::*side)
{
    std::vector<LegJoints> legs;
    std::ranges::transform(pairs, std::back_inserter(legs), side);
    return legs;
}

// A mapping may take a knee for its own ankle.
bool IsLength(double leg)
{
    return std::isfinite(leg) && leg > 0.0;
}

// A foot without a toe joint takes its heading from the other side.
void LendHeading(CLegTrack& source, CLegTrack& result)
{
    if (!result.HasToe())
        result.SetHeading(source.HasToe() ? source.Heading() : kVec3UnitZ);
    if (!source.HasToe())
        source.SetHeading(result.Heading());
}

std::optional<double> FloorHeight(const CFeetTrack& feet, const std::vector<std::vector<Contact>>& contacts)
{
    std::vector<float> heights;
    for (size_t leg = 0; leg < contacts.size(); ++leg)
    {
        const auto& postures = feet.Legs()[leg].Postures();
        for (const Contact& contact : contacts[leg])
            std::transform(postures.begin() + contact.first, postures.begin() + contact.end,
                           std::back_inserter(heights),
                           [](const auto& posture) { return posture.soleHeight; });
    }
    if (heights.empty())
        return std::nullopt;
    return static_cast<double>(Percentile(std::move(heights), kMedian));
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

// One number of a leg's postures, frame by frame: (number - floor) x scale.
std::vector<float> Curve(const CLegTrack& leg, float CLegTrack::Posture::*number, double floor = 0.0,
                         double scale = 1.0)
{
    std::vector<float> curve;
    curve.reserve(leg.Postures().size());
    for (const CLegTrack::Posture& posture : leg.Postures())
        curve.push_back(static_cast<float>((static_cast<double>(posture.*number) - floor) * scale));
    return curve;
}

// Below this share of a leg an ankle stands on its floor as none does: the skeleton has no sole.
constexpr double kNoSole = 0.01;

// How far the floor lies under the soles of the source, where these are its ankles: as far in leg lengths as
// under those of the result.
double DepthUnderSoles(const CFeetTrack& source, const CFeetTrack& result)
{
    if (source.Legs()[0].AnkleHeight() > kNoSole * source.LegLength())
        return 0.0;
    return result.Legs()[0].AnkleHeight() / result.LegLength() * source.LegLength();
}

// The height on which the soles of a skeleton stand.
double SoleFloor(const std::vector<CLegTrack>& legs)
{
    std::vector<float> heights;
    for (const CLegTrack& leg : legs)
        std::ranges::transform(leg.Postures(), std::back_inserter(heights), &CLegTrack::Posture::soleHeight);
    return static_cast<double>(Percentile(std::move(heights), kFloorShare));
}

} // namespace

CFeetMeter::CFeetMeter(std::vector<LegPair> legs)
    : m_kPairs(std::move(legs)), m_kSource(LegsOf(m_kPairs, &LegPair::source)),
      m_kResult(LegsOf(m_kPairs, &LegPair::result))
{
}

void CFeetMeter::WatchJoints(CPoseSampler& source, CPoseSampler& result) const
{
    m_kSource.WatchJoints(source);
    m_kResult.WatchJoints(result);
}

void CFeetMeter::Begin()
{
    m_kSource.MeasureLegs();
    m_kResult.MeasureLegs();
    for (size_t i = 0; i < m_kPairs.size(); ++i)
        LendHeading(m_kSource.Legs()[i], m_kResult.Legs()[i]);
}

void CFeetMeter::Add()
{
    m_kSource.Append();
    m_kResult.Append();
}

void CFeetMeter::WriteDetail(ConversionDetail& detail, const LegContacts& source,
                             const LegContacts& result) const
{
    const double scale = ResultLeg() / SourceLeg();
    const double soleFloor = SoleFloor(m_kSource.Legs());
    detail.sourceFloor = soleFloor - DepthUnderSoles(m_kSource, m_kResult);
    for (size_t i = 0; i < m_kPairs.size(); ++i)
    {
        const CLegTrack& from = m_kSource.Legs()[i];
        const CLegTrack& to = m_kResult.Legs()[i];
        detail.feet.push_back({Curve(from, &CLegTrack::Posture::soleHeight, soleFloor, scale),
                               Curve(to, &CLegTrack::Posture::soleHeight),
                               Curve(from, &CLegTrack::Posture::kneeAngle),
                               Curve(to, &CLegTrack::Posture::kneeAngle), source[i], result[i]});
    }
}

void CFeetMeter::Write(ConversionMeasures& measures, double secondsPerFrame, ConversionDetail* detail) const
{
    if (!IsLength(SourceLeg()) || !IsLength(ResultLeg()))
        return;
    const auto sourceContacts = m_kSource.Contacts(secondsPerFrame);
    const auto resultContacts = m_kResult.Contacts(secondsPerFrame);
    for (size_t i = 0; i < m_kPairs.size(); ++i)
    {
        FootMeasures foot = MeasureFoot({m_kSource.Legs()[i], sourceContacts[i], SourceLeg()},
                                        {m_kResult.Legs()[i], resultContacts[i], ResultLeg()});
        foot.target = m_kPairs[i].ankles.target->NameView();
        foot.source = m_kPairs[i].ankles.source->NameView();
        measures.feet.push_back(std::move(foot));
    }
    measures.sourceLeg = SourceLeg();
    measures.resultLeg = ResultLeg();
    measures.contactF1 = CommonF1(measures.feet);
    measures.floorHeight = FloorHeight(m_kResult, resultContacts);
    measures.sinkDepth = SinkDepth(m_kResult.Legs());
    if (detail)
        WriteDetail(*detail, sourceContacts, resultContacts);
}

} // namespace gw
