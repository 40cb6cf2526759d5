// On a body with other proportions, three things cannot all hold: feet that stay planted, hips that move like
// the source's, and legs that point in the source's directions. What gives way is decided by what a viewer
// notices. Nobody sees that the hips are a centimeter higher; everybody sees a knee jerk, a foot slide or the
// hips sway.
//
// So the midpoint of the hip joints follows the source's path over the ground, and the root is placed to
// match. The source's leg directions then give the free path of each ankle. Contacts hold the foot close to
// that path (StandSteps, HoldFoot) and put its sole on the floor (LandFoot). If the legs are now too short or
// too long, the height of the hips makes up the difference: a smooth curve, fitted by least squares over all
// frames. The ankles depend on that height, so the fit is iterated. Three rounds are enough, because each
// leaves only a small part of the error it started with. The knee absorbs the rest, as far as it is bent and
// can do so without a jerk (YieldKnee). What is then left between sole and floor is a few millimeters. A foot
// that is pitched by a few degrees closes that gap with its toe, and the leg need not move. Where the foot
// stands is then planned once more, because its toe has moved.

#include "CStandPlan.h"

#include "CBandFit.h"
#include "Directions.h"
#include "Figures.h"
#include "FootPitch.h"
#include "HoldFoot.h"
#include "LandFoot.h"
#include "StandSteps.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Lengths are in millimeters of the target.
constexpr int kRounds = 3;
constexpr double kLiftHertz = 5.0;      // fast enough for the steps of a run, too slow for a rocking foot
constexpr double kRestWeight = 1e-4;    // weight of no lift at all; a standing leg has weight 1
constexpr double kLiftLimit = 150.0;    // a source that needs more does not stand on a single floor
constexpr double kMissed = 8.0;         // a standing foot whose sole is off by this much counts twice
constexpr float kWristHeight = 30.0f;   // of a hand that is flat on the floor
constexpr double kLeastToe = 10.0;      // from a source's toe joint down to its sole
constexpr double kMostToeTurn = 0.08;   // radians; a toe end that is farther from the floor is left there
constexpr double kToeReach = 10.0;      // beyond that, over which a toe end is pulled less and less
constexpr double kToeWeight = 25.0;     // weight of a toe end on the floor; the foot's own pitch has weight 1
constexpr double kToeHertz = 3.0;       // of the changes between the two
constexpr double kSurelyAloft = 10.0;   // height of a foot that is certainly off the floor
constexpr double kSlightLift = 15.0;    // of a sole; hardly seen
constexpr double kAloftMargin = 0.004;  // in leg lengths, so that rounding does not put the foot on the floor
constexpr double kMostAloft = 0.11;     // in leg lengths; above that, no foot stands
constexpr double kLeastFirmness = 0.02; // minimum for any leg, however far its knee is bent

double ScaleOf(const std::vector<CFaithfulLeg>& legs, double sourceLeg)
{
    CRunningMean lengths;
    for (const CFaithfulLeg& leg : legs)
        lengths.Add(leg.Lengths().Straight());
    const double scale = lengths.Mean() / sourceLeg;
    return std::isfinite(scale) ? scale : 1.0;
}

} // namespace

CStandPlan::CStandPlan(const std::vector<CFaithfulLeg>& legs, const CSourceBody& source, float lowestHand,
                       const Vec3& origin, double secondsPerFrame, bool holdFeet)
    : legs_(legs), source_(source), m_fScale(ScaleOf(legs, source.LegLength())),
      m_kRoots(source.FrameCount(), kVec3Zero), m_kLifts(source.FrameCount(), 0.0f)
{
    const std::vector<FootTouches>& touches = source.Touches();
    PlaceRoot(origin);
    StandOnFloor(touches, lowestHand);
    const bool stands = std::ranges::any_of(touches, [](const auto& leg) { return !leg.flat.empty(); });
    m_bHasFloor = m_bHasFloor || stands;
    if (!holdFeet || !stands)
        return;
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        HoldLeg(leg, touches[leg], secondsPerFrame);
        LandLeg(leg, touches[leg], secondsPerFrame);
    }
    for (int round = 0; round < kRounds; ++round)
        LiftRoot(secondsPerFrame);
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        LowerToe(leg, secondsPerFrame);
        HoldLeg(leg, touches[leg], secondsPerFrame);
    }
}

// Returns the midpoint of the target's hip joints, relative to its root.
Vec3 CStandPlan::Hips(size_t frame) const
{
    Vec3 hips = kVec3Zero;
    for (const CFaithfulLeg& leg : legs_)
        hips = hips + leg.At(frame).hip * (1.0f / static_cast<float>(legs_.size()));
    return hips;
}

void CStandPlan::PlaceRoot(const Vec3& origin)
{
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
        m_kRoots[frame] =
            (source_.Hips(frame) - source_.Hips(0)) * static_cast<float>(m_fScale) - Hips(frame);
    const Vec3 shift = m_kRoots.empty() ? kVec3Zero : OverGround(origin - m_kRoots.front());
    for (Vec3& root : m_kRoots)
        root = root + shift;
}

// Returns the position of the ankle if the leg points in the source's directions.
Vec3 CStandPlan::FreeAnkle(size_t leg, size_t frame) const
{
    return m_kRoots[frame] + legs_[leg].At(frame).hip + legs_[leg].Stretch(frame);
}

// Returns the height of the lower end of that foot's sole.
float CStandPlan::FreeSole(size_t leg, size_t frame) const
{
    return FreeAnkle(leg, frame).y - legs_[leg].At(frame).sole;
}

// Raises or lowers the whole motion onto the floor, using the median of the contacts. Without contacts, the
// lowest frames of the feet are on the floor, or the hands if they get even lower, as in a handstand.
void CStandPlan::StandOnFloor(const std::vector<FootTouches>& touches, float lowestHand)
{
    if (m_kRoots.empty())
        return;
    std::vector<float> standing;
    std::vector<float> all;
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        for (const Contact& contact : touches[leg].flat)
        {
            for (int frame = contact.first; frame < contact.end; ++frame)
                standing.push_back(-FreeSole(leg, static_cast<size_t>(frame)));
        }
        for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
            all.push_back(-FreeSole(leg, frame));
    }
    const bool stands = !standing.empty();
    float lift =
        stands ? Percentile(std::move(standing), 0.5) : Percentile(std::move(all), 1.0 - kFloorShare);
    const float hands = kWristHeight - (lowestHand - source_.Hips(0).y) * static_cast<float>(m_fScale);
    if (!stands && std::isfinite(hands) && hands > lift)
    {
        lift = hands;
        m_bHasFloor = true;
    }
    for (Vec3& root : m_kRoots)
        root.y += lift;
    m_fRaised = lift - source_.Hips(0).y * static_cast<float>(m_fScale);
    const float floor = source_.Floor(kLeastToe / m_fScale);
    if (stands && std::isfinite(floor))
        m_fRaised = -floor * static_cast<float>(m_fScale);
}

Vec3 CStandPlan::OnTarget(const Vec3& place) const
{
    return place * static_cast<float>(m_fScale) + Vec3{0.0f, m_fRaised, 0.0f};
}

std::vector<Vec3> CStandPlan::Scaled(const std::vector<Vec3>& places) const
{
    std::vector<Vec3> scaled;
    scaled.reserve(places.size());
    for (const Vec3& place : places)
        scaled.push_back(place * static_cast<float>(m_fScale));
    return scaled;
}

void CStandPlan::HoldLeg(size_t leg, const FootTouches& touches, double secondsPerFrame)
{
    std::vector<Vec3> free;
    std::vector<Vec3> toe;
    free.reserve(m_kRoots.size());
    toe.reserve(m_kRoots.size());
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        free.push_back(FreeAnkle(leg, frame));
        toe.push_back(Turned(legs_[leg].At(frame).toe, ToeTurn(leg, frame)));
    }
    const CLegTrack& track = source_.Leg(leg);
    const std::vector<Vec3> sourceAnkle = Scaled(track.Ankles());
    std::vector<Vec3> sourceToe = Scaled(track.Toes());
    for (size_t frame = sourceToe.size(); frame < sourceAnkle.size(); ++frame)
        sourceToe.push_back(sourceAnkle[frame] + toe[frame]);
    const double length = legs_[leg].Lengths().Straight();
    const StandingFoot standing =
        StandSteps({toe, sourceAnkle, sourceToe, length},
                   {touches.contacts, touches.ankle, touches.toe, source_.Jumps()}, secondsPerFrame);
    const std::vector<Vec3> held = HoldFoot(free, standing.steps, touches.contacts, secondsPerFrame);
    if (leg == m_kAnkles.size())
        m_kAnkles.push_back(held);
    for (size_t frame = 0; frame < held.size(); ++frame)
    {
        m_kAnkles[leg][frame].x = held[frame].x;
        m_kAnkles[leg][frame].z = held[frame].z;
    }
}

// Returns where the sole should be. A foot that is still but above the floor, on a step for example, is as
// far from standing as the source's: its higher joint is at least as high, without the sole being lifted
// farther than the source's lower joint. It may be lower on its free path, because the feet stand at several
// heights and the plan has only one floor.
SoleWish CStandPlan::WishedSole(size_t leg, size_t frame, const FootTouches& touches) const
{
    const CFaithfulLeg& of = legs_[leg];
    const FootState& state = touches.states[frame];
    const double length = of.Lengths().Straight();
    const float free = FreeSole(leg, frame);
    const float pitched = of.At(frame).sole - std::min(of.AnkleHeight(), of.ToeSole(frame));
    const double height = static_cast<double>(state.height) + kAloftMargin;
    const double most = static_cast<double>(state.lowHeight) * length + kSlightLift;
    const double least = std::min(std::min(height, kMostAloft) * length - static_cast<double>(pitched), most);
    const double aloft = static_cast<double>(state.aloft) * Smoothstep(least / kSurelyAloft) *
                         Smoothstep(static_cast<double>(free) / kSurelyAloft);
    return {free, state.landed * static_cast<float>(1.0 - aloft), static_cast<float>(aloft),
            static_cast<float>(least)};
}

void CStandPlan::LandLeg(size_t leg, const FootTouches& touches, double secondsPerFrame)
{
    std::vector<SoleWish> wishes;
    std::vector<float> landed;
    wishes.reserve(m_kRoots.size());
    landed.reserve(m_kRoots.size());
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        wishes.push_back(WishedSole(leg, frame, touches));
        landed.push_back(wishes.back().landed);
    }
    const std::vector<double> soles = LandFoot(wishes, secondsPerFrame);
    m_kLanded.push_back(std::move(landed));
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
        m_kAnkles[leg][frame].y = static_cast<float>(soles[frame]) + legs_[leg].At(frame).sole;
}

// If a leg is too long for the distance to its ankle, its hip should rise by the difference. A slanted leg
// needs more lift, with less weight. A bent knee absorbs most of the difference, so it gets little weight; a
// sole that would end up above or below the floor gets more.
void CStandPlan::AddWish(size_t leg, size_t frame, CBandFit& lifts) const
{
    const LegLengths& lengths = legs_[leg].Lengths();
    const Vec3 way = m_kAnkles[leg][frame] - m_kRoots[frame] - legs_[leg].At(frame).hip;
    const double distance = Vec3Length(way);
    const double bend = legs_[leg].KneeBend(frame);
    const double yielded = YieldingBend(lengths, distance, bend, kKneeStiffness);
    const double slope = SquareSlopeAt(lengths, 0.5 * (bend + yielded)) / (kKneeStiffness * kKneeStiffness);
    const double missed =
        static_cast<double>(m_kLanded[leg][frame]) * (distance - ReachAt(lengths, yielded)) / kMissed;
    const double firmness = kLeastFirmness + (1.0 + missed * missed) / (1.0 + slope);
    const double upright = static_cast<double>(-way.y) / distance;
    const double lift = static_cast<double>(m_kLifts[frame]) + (ReachAt(lengths, bend) - distance) / upright;
    lifts.AddValue(frame, firmness * upright * upright, std::clamp(lift, -kLiftLimit, kLiftLimit));
}

void CStandPlan::LiftRoot(double secondsPerFrame)
{
    CBandFit wishes(m_kRoots.size(), BendWeight(kLiftHertz, secondsPerFrame), kRestWeight);
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
            AddWish(leg, frame, wishes);
    }
    const std::vector<double> lifts = wishes.Solve();
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        const auto lift = static_cast<float>(lifts[frame]);
        m_kRoots[frame].y += lift - m_kLifts[frame];
        m_kLifts[frame] = lift;
    }
}

// The toe end of a sole should be on the floor if it is near it. If the heel is deeper, the toe end should at
// least not be below it.
double CStandPlan::WantedToeDrop(size_t leg, size_t frame) const
{
    const CFaithfulLeg::Frame& at = legs_[leg].At(frame);
    const auto ankle = static_cast<double>(m_kRoots[frame].y + at.hip.y + Ankle(leg, frame).y);
    const auto heel = static_cast<double>(at.heel);
    const auto toe = static_cast<double>(legs_[leg].ToeSole(frame));
    const double drop = (ankle >= heel ? ankle : std::min(toe, heel)) - toe;
    const double most = kMostToeTurn * ToePlaceOf(at.toe).ahead;
    return drop * (1.0 - Smoothstep((std::fabs(drop) - most) / (most + kToeReach)));
}

void CStandPlan::LowerToe(size_t leg, double secondsPerFrame)
{
    CBandFit drops(m_kRoots.size(), BendWeight(kToeHertz, secondsPerFrame), 1.0);
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        const auto landed = static_cast<double>(m_kLanded[leg][frame]);
        if (landed > 0.0)
            drops.AddValue(frame, kToeWeight * landed, WantedToeDrop(leg, frame));
    }
    std::vector<Mat3>& turns = m_kToeTurns.emplace_back();
    turns.reserve(m_kRoots.size());
    for (const double drop : drops.Solve())
        turns.push_back(LoweredToe(legs_[leg].At(turns.size()).toe, drop));
}

const Mat3& CStandPlan::ToeTurn(size_t leg, size_t frame) const
{
    return leg < m_kToeTurns.size() ? m_kToeTurns[leg][frame] : kMat3Identity;
}

Vec3 CStandPlan::Ankle(size_t leg, size_t frame) const
{
    if (m_kAnkles.empty())
        return legs_[leg].Stretch(frame);
    const Vec3 asked = m_kAnkles[leg][frame] - m_kRoots[frame] - legs_[leg].At(frame).hip;
    const double distance = Vec3Length(asked);
    const LegLengths& lengths = legs_[leg].Lengths();
    const double bend = YieldingBend(lengths, distance, legs_[leg].KneeBend(frame), kKneeStiffness);
    return asked * static_cast<float>(ReachAt(lengths, bend) / distance);
}

} // namespace gw
