#include "MeasureFoot.h"

#include "Angles.h"
#include "CLegTrack.h"
#include "Figures.h"

#include <cmath>
#include <numeric>

namespace gw {

namespace {

constexpr double kFlatEnough = 0.5; // a foot within 30 degrees of upright has no heading worth the name
constexpr double kPopDegrees = 5.0; // what the eye takes for a jerk, in a walk as in a run

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

// The angle about y from one direction to another in degrees, -180 to 180.
double TurnBetween(const Vec3& from, const Vec3& to)
{
    const auto yaw = [](const Vec3& v) {
        return std::atan2(static_cast<double>(v.x), static_cast<double>(v.z));
    };
    return std::remainder(yaw(to) - yaw(from), kTwoPi64) * kRadiansToDegrees64;
}

void MeasureTurn(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    const std::vector<bool> stands = StandingFrames(source.contacts, source.track.Postures().size());
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
    const CRunningMean tilts = SoleTilts(result.track, source.contacts);
    foot.soleTiltMean = tilts.Mean();
    foot.soleTiltLargest = tilts.Largest();
    foot.sourceSoleTiltMean = SoleTilts(source.track, source.contacts).Mean();
}

struct Slide
{
    double share = 0.0; // in leg lengths
    int frame = 0;
};

// How far the ankle goes from where a contact begins.
Slide SlideIn(const FootSide& side, const Contact& contact)
{
    const std::vector<Vec3>& ankles = side.track.Ankles();
    Slide slide{0.0, contact.first};
    for (int f = contact.first; f < contact.end; ++f)
    {
        const double distance =
            GroundDistance(ankles[static_cast<size_t>(contact.first)], ankles[static_cast<size_t>(f)]);
        if (distance / side.leg > slide.share)
            slide = {distance / side.leg, f};
    }
    return slide;
}

void MeasureSlide(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    CRunningMean sourceSlides;
    CRunningMean resultSlides;
    CRunningMean added;
    for (const Contact& contact : source.contacts)
    {
        const double sourceSlide = SlideIn(source, contact).share;
        const Slide resultSlide = SlideIn(result, contact);
        const double addedSlide = resultSlide.share - sourceSlide;
        if (added.Count() == 0 || addedSlide > added.Largest())
            foot.addedSlideFrame = resultSlide.frame;
        sourceSlides.Add(sourceSlide);
        resultSlides.Add(resultSlide.share);
        added.Add(addedSlide);
    }
    foot.sourceSlideShare = sourceSlides.Mean();
    foot.resultSlideShare = resultSlides.Mean();
    foot.addedSlideMeanShare = added.Mean();
    foot.addedSlideLargestShare = added.Largest();
    foot.addedSlideMean = added.Mean() * result.leg;
    foot.addedSlideLargest = added.Largest() * result.leg;
}

void MeasureContacts(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    const size_t frameCount = source.track.Postures().size();
    const std::vector<bool> sourceStands = StandingFrames(source.contacts, frameCount);
    const std::vector<bool> resultStands = StandingFrames(result.contacts, frameCount);
    foot.sourceContacts = source.contacts.size();
    foot.resultContacts = result.contacts.size();
    for (size_t f = 0; f < frameCount; ++f)
    {
        foot.sourceStanding += sourceStands[f] ? 1 : 0;
        foot.resultStanding += resultStands[f] ? 1 : 0;
        foot.bothStanding += sourceStands[f] && resultStands[f] ? 1 : 0;
    }
    foot.contactF1 = RatioOf(2.0 * static_cast<double>(foot.bothStanding),
                             static_cast<double>(foot.sourceStanding + foot.resultStanding));
}

void MeasureKnee(const FootSide& source, const FootSide& result, FootMeasures& foot)
{
    const auto change = [](const FootSide& side, size_t f) {
        const auto& postures = side.track.Postures();
        return std::fabs(static_cast<double>(postures[f].kneeAngle - postures[f - 1].kneeAngle));
    };
    for (size_t f = 1; f < source.track.Postures().size(); ++f)
    {
        const double sourceChange = change(source, f);
        const double resultChange = change(result, f);
        if (resultChange - sourceChange > kPopDegrees)
            foot.kneePopFrames.push_back(static_cast<int>(f));
        if (resultChange - sourceChange > foot.kneePopLargest)
        {
            foot.kneePopLargest = resultChange - sourceChange;
            foot.kneePopFrame = static_cast<int>(f);
        }
        foot.kneeChangeLargest = std::max(foot.kneeChangeLargest, resultChange);
        foot.sourceKneeChangeLargest = std::max(foot.sourceKneeChangeLargest, sourceChange);
    }
    foot.kneePops = foot.kneePopFrames.size();
}

} // namespace

FootMeasures MeasureFoot(const FootSide& source, const FootSide& result)
{
    FootMeasures foot;
    MeasureTurn(source, result, foot);
    MeasureSoles(source, result, foot);
    MeasureSlide(source, result, foot);
    MeasureContacts(source, result, foot);
    MeasureKnee(source, result, foot);
    return foot;
}

} // namespace gw
