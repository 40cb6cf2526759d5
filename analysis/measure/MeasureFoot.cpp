#include "MeasureFoot.h"

#include "Angles.h"
#include "CLegTrack.h"
#include "Figures.h"
#include "Series.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kFlatEnough = 0.5; // a foot within 30 degrees of vertical has no useful heading
constexpr double kPopDegrees = 5.0; // a visible jerk, in a walk or a run
constexpr double kPopSeconds = 1.0 / 30.0;
constexpr double kPopSlack = 1.0 / 15.0; // the source's knee may bend this much earlier or later
// Speeds in mm/s between which it is unclear whether a foot stands.
constexpr double kSurelyStands = 150.0;
constexpr double kSurelyMoves = 300.0;
constexpr double kHalfSpeedSeconds = 1.0 / 60.0; // speeds are measured over twice this time

std::vector<bool> StandingFrames(const std::vector<Contact>& contacts, size_t frameCount)
{
    std::vector<bool> stands(frameCount);
    for (const Contact& contact : contacts)
        std::fill(stands.begin() + contact.first, stands.begin() + contact.end, true);
    return stands;
}

bool HasHeading(const Vec3& direction)
{
    return std::hypot(static_cast<double>(direction.x), static_cast<double>(direction.z)) >= kFlatEnough;
}

// Returns the angle about y from one direction to another in degrees, -180 to 180.
double TurnBetween(const Vec3& from, const Vec3& to)
{
    const auto yaw = [](const Vec3& v) {
        return std::atan2(static_cast<double>(v.x), static_cast<double>(v.z));
    };
    return std::remainder(yaw(to) - yaw(from), kTwoPi64) * kRadiansToDegrees64;
}

void MeasureTurn(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    const std::vector<bool> stands = StandingFrames(source.plants.foot, source.track.Postures().size());
    CRunningMean turns;
    CRunningMean errors;
    CRunningMean standing;
    for (size_t f = 0; f < stands.size(); ++f)
    {
        const Vec3& from = source.track.Postures()[f].heading;
        const Vec3& to = result.track.Postures()[f].heading;
        if (!HasHeading(from) || !HasHeading(to))
            continue;
        const double turn = TurnBetween(from, to);
        turns.Add(turn);
        errors.Add(std::fabs(turn));
        if (stands[f])
            standing.Add(std::fabs(turn));
    }
    foot.turnMean = turns.Mean();
    foot.turnError = errors.Mean();
    foot.turnLargest = errors.Largest();
    foot.turnWhileStanding = standing.Mean();
    foot.turnFromStart = !source.track.HasToe() || !result.track.HasToe();
}

CRunningMean SoleTilts(const CLegTrack& track, const std::vector<Contact>& contacts)
{
    CRunningMean tilts;
    for (const Contact& contact : contacts)
    {
        for (int f = contact.first; f < contact.end; ++f)
            tilts.Add(static_cast<double>(track.Postures()[static_cast<size_t>(f)].soleTilt));
    }
    return tilts;
}

void MeasureSoles(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    const CRunningMean tilts = SoleTilts(result.track, source.plants.foot);
    foot.soleTiltMean = tilts.Mean();
    foot.soleTiltLargest = tilts.Largest();
    foot.sourceSoleTiltMean = SoleTilts(source.track, source.plants.foot).Mean();
}

PlantSlide SlideIn(const std::vector<Vec3>& places, const Contact& plant, double scale)
{
    PlantSlide slide{0.0, plant.first};
    for (int f = plant.first; f < plant.end; ++f)
    {
        const double distance =
            GroundDistance(places[static_cast<size_t>(plant.first)], places[static_cast<size_t>(f)]) * scale;
        if (distance > slide.added)
            slide = {distance, f};
    }
    return slide;
}

std::vector<PlantSlide> AddedSlides(const FootSide& source, const FootSide& result,
                                    const std::vector<Contact>& plants,
                                    const std::vector<Vec3>& (CLegTrack::*joint)() const)
{
    std::vector<PlantSlide> slides;
    for (const Contact& plant : plants)
    {
        const PlantSlide of = SlideIn((source.track.*joint)(), plant, source.scale);
        PlantSlide slide = SlideIn((result.track.*joint)(), plant, result.scale);
        slide.added -= of.added;
        slides.push_back(slide);
    }
    return slides;
}

// Returns the speed of a foot's faster joint for each frame, in mm of the result per second.
std::vector<double> SpeedsOf(const FootSide& side, double secondsPerFrame)
{
    const int span = FramesIn(kHalfSpeedSeconds, secondsPerFrame);
    std::vector<double> speeds(side.track.Postures().size());
    for (const std::vector<Vec3>* joint : {&side.track.Ankles(), &side.track.Toes()})
    {
        const int last = static_cast<int>(joint->size()) - 1;
        for (int f = 0; f <= last; ++f)
        {
            const int before = std::max(f - span, 0);
            const int after = std::min(f + span, last);
            const Vec3 way = (*joint)[static_cast<size_t>(after)] - (*joint)[static_cast<size_t>(before)];
            double& speed = speeds[static_cast<size_t>(f)];
            speed = std::max(speed,
                             Vec3Length(way) * side.scale / (secondsPerFrame * std::max(after - before, 1)));
        }
    }
    return speeds;
}

void MeasureContacts(const FootSide& source, const FootSide& result, double secondsPerFrame,
                     FootMeasures& foot)
{
    const std::vector<double> speeds = SpeedsOf(source, secondsPerFrame);
    const std::vector<bool> sourceStands = StandingFrames(source.plants.foot, speeds.size());
    const std::vector<bool> resultStands = StandingFrames(result.plants.foot, speeds.size());
    foot.sourceContacts = source.plants.foot.size();
    foot.resultContacts = result.plants.foot.size();
    for (size_t f = 0; f < speeds.size(); ++f)
    {
        if (speeds[f] >= kSurelyStands && speeds[f] <= kSurelyMoves)
            continue;
        foot.sourceStanding += sourceStands[f] ? 1 : 0;
        foot.resultStanding += resultStands[f] ? 1 : 0;
        foot.bothStanding += sourceStands[f] && resultStands[f] ? 1 : 0;
    }
    foot.contactF1 = RatioOf(2.0 * static_cast<double>(foot.bothStanding),
                             static_cast<double>(foot.sourceStanding + foot.resultStanding));
}

void MeasureHeldSoles(const FootSide& source, const FootSide& result, MeasuredFoot& foot)
{
    for (const Contact& contact : source.plants.foot)
    {
        for (int f = contact.first; f < contact.end; ++f)
        {
            const float height = result.track.Postures()[static_cast<size_t>(f)].soleHeight;
            const double away = std::fabs(static_cast<double>(height)) * result.scale;
            foot.heldSoles.push_back(static_cast<float>(away));
            if (!std::isfinite(away) || away <= foot.figures.heldSoleLargest.value_or(-1.0))
                continue;
            foot.figures.heldSoleLargest = away;
            foot.figures.heldSoleFrame = f;
        }
    }
    if (!foot.heldSoles.empty())
        foot.figures.heldSole = static_cast<double>(Percentile(foot.heldSoles, kMostShare));
}

std::vector<float> KneeAngles(const CLegTrack& track)
{
    std::vector<float> angles;
    angles.reserve(track.Postures().size());
    for (const CLegTrack::Posture& posture : track.Postures())
        angles.push_back(posture.kneeAngle);
    return angles;
}

void MeasureKnee(const FootSide& source, const FootSide& result, double secondsPerFrame, FootMeasures& foot)
{
    const int span = FramesIn(kPopSeconds, secondsPerFrame);
    const int slack = FramesIn(kPopSlack, secondsPerFrame);
    const std::vector<float> changes = LargestChanges(KneeAngles(result.track), span);
    const std::vector<float> allowed =
        SlidingLargest(LargestChanges(KneeAngles(source.track), span), slack, slack);
    bool pops = false;
    double worst = 0.0; // of the current pop
    for (size_t f = 0; f < changes.size(); ++f)
    {
        const auto excess = static_cast<double>(changes[f] - allowed[f]);
        const auto frame = static_cast<int>(f);
        if (excess > foot.kneePopLargest)
        {
            foot.kneePopLargest = excess;
            foot.kneePopFrame = frame;
        }
        const bool popped = pops;
        pops = excess > kPopDegrees;
        if (pops && !popped)
            foot.kneePopFrames.push_back(frame);
        else if (pops && excess > worst)
            foot.kneePopFrames.back() = frame;
        worst = pops && popped ? std::max(worst, excess) : excess;
    }
    foot.kneePops = foot.kneePopFrames.size();
}

} // namespace

MeasuredFoot MeasureFoot(const FootSide& source, const FootSide& result, double secondsPerFrame)
{
    MeasuredFoot foot;
    MeasureTurn(source, result, foot.figures);
    MeasureSoles(source, result, foot.figures);
    foot.ankleSlides = AddedSlides(source, result, source.plants.ankle, &CLegTrack::Ankles);
    if (result.track.HasToe())
        foot.toeSlides = AddedSlides(source, result, source.plants.toe, &CLegTrack::Toes);
    foot.figures.ankleSlide = SummaryOf(foot.ankleSlides);
    foot.figures.toeSlide = SummaryOf(foot.toeSlides);
    MeasureContacts(source, result, secondsPerFrame, foot.figures);
    MeasureHeldSoles(source, result, foot);
    MeasureKnee(source, result, secondsPerFrame, foot.figures);
    return foot;
}

SlideMeasures SummaryOf(const std::vector<PlantSlide>& slides)
{
    SlideMeasures summary;
    summary.plants = slides.size();
    std::vector<float> added;
    for (const PlantSlide& slide : slides)
    {
        added.push_back(static_cast<float>(slide.added));
        if (added.size() > 1 && !(slide.added > summary.largest))
            continue;
        summary.largest = std::isfinite(slide.added) ? slide.added : 0.0;
        summary.largestFrame = slide.frame;
    }
    summary.median = Median(std::move(added));
    return summary;
}

} // namespace gw
