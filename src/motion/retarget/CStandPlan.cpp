// Feet that stand, hips that go as the source's and legs that point as the source's cannot all be had on a
// body of other proportions. What gives way is chosen by what an eye forgives: nobody sees that the hips go a
// centimetre higher, everybody that a knee jerks, a foot slides or the hips swing.
//
// So the middle of the hip joints goes the source's way over the ground, and the root is wherever its hips
// then have it. The source's directions give the free path of each ankle. Contacts hold the foot near to it
// (HoldFoot) and put its sole on the floor (LandFoot). What the legs then lack or have too much, the hips'
// height gives them: a smooth curve by least squares over all frames. Where the ankles go hangs on that
// height, so this is done in rounds; three are enough, since each leaves a small part of what it found. What
// is left over is the knee's, as far as it is bent and can take that without a jerk (YieldKnee).

#include "CStandPlan.h"

#include "CBandFit.h"
#include "Figures.h"
#include "HoldFoot.h"
#include "LandFoot.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Lengths are millimetres of the target.
constexpr int kRounds = 3;
constexpr double kLiftHertz = 5.0;      // the height of the hips follows a run's steps, not a foot that rocks
constexpr double kRestWeight = 1e-4;    // of no lift at all, against 1 for a leg that stands
constexpr double kLiftLimit = 150.0;    // a source that asks for more does not stand on one floor
constexpr double kMissed = 8.0;         // of a foot that stands: a sole so far off counts twice
constexpr double kLeastFirmness = 0.02; // of a leg whose knee is bent, however far

double ScaleOf(const std::vector<CFaithfulLeg>& legs, double sourceLeg)
{
    CRunningMean lengths;
    for (const CFaithfulLeg& leg : legs)
        lengths.Add(leg.Lengths().upper + leg.Lengths().lower);
    const double scale = lengths.Mean() / sourceLeg;
    return std::isfinite(scale) ? scale : 1.0;
}

} // namespace

CStandPlan::CStandPlan(const std::vector<CFaithfulLeg>& legs, const CSourceBody& source, const Vec3& origin,
                       double secondsPerFrame, bool holdFeet)
    : legs_(legs), source_(source), m_fScale(ScaleOf(legs, source.LegLength())),
      m_kRoots(source.FrameCount(), kVec3Zero), m_kLifts(source.FrameCount(), 0.0f)
{
    const ContactsOfLegs contacts = source.Contacts(secondsPerFrame);
    PlaceRoot(origin);
    StandOnFloor(contacts);
    m_bHasFloor = std::ranges::any_of(contacts, [](const auto& leg) { return !leg.empty(); });
    if (!holdFeet || !m_bHasFloor)
        return;
    const std::vector<FootTouches> touches = source.Touches(secondsPerFrame);
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        HoldLeg(leg, touches[leg].contacts, secondsPerFrame);
        LandLeg(leg, touches[leg].landed, secondsPerFrame);
    }
    for (int round = 0; round < kRounds; ++round)
        LiftRoot(secondsPerFrame);
}

// The middle of the target's hip joints from its root.
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

// The place of an ankle whose leg points as the source's.
Vec3 CStandPlan::FreeAnkle(size_t leg, size_t frame) const
{
    return m_kRoots[frame] + legs_[leg].At(frame).hip + legs_[leg].Stretch(frame);
}

// The height of the lower end of its sole.
float CStandPlan::FreeSole(size_t leg, size_t frame) const
{
    return FreeAnkle(leg, frame).y - legs_[leg].At(frame).sole;
}

// Raises the whole motion so that it stands on the floor: by the median of the contacts, and where there are
// none by its lowest frames.
void CStandPlan::StandOnFloor(const ContactsOfLegs& contacts)
{
    std::vector<float> standing;
    std::vector<float> all;
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        for (const Contact& contact : contacts[leg])
        {
            for (int frame = contact.first; frame < contact.end; ++frame)
                standing.push_back(-FreeSole(leg, static_cast<size_t>(frame)));
        }
        for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
            all.push_back(-FreeSole(leg, frame));
    }
    const float lift = standing.empty() ? Percentile(std::move(all), 1.0 - kFloorShare)
                                        : Percentile(std::move(standing), 0.5);
    for (Vec3& root : m_kRoots)
        root.y += lift;
    if (!m_kRoots.empty())
        m_fRaised = lift - source_.Hips(0).y * static_cast<float>(m_fScale);
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

void CStandPlan::HoldLeg(size_t leg, const std::vector<Contact>& contacts, double secondsPerFrame)
{
    std::vector<Vec3> free;
    std::vector<Vec3> toe;
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        free.push_back(FreeAnkle(leg, frame));
        toe.push_back(legs_[leg].At(frame).toe);
    }
    const CLegTrack& track = source_.Leg(leg);
    const std::vector<Vec3> sourceAnkle = Scaled(track.Ankles());
    std::vector<Vec3> sourceToe = Scaled(track.Toes());
    for (size_t frame = sourceToe.size(); frame < sourceAnkle.size(); ++frame)
        sourceToe.push_back(sourceAnkle[frame] + toe[frame]);
    const double length = legs_[leg].Lengths().upper + legs_[leg].Lengths().lower;
    m_kAnkles.push_back(HoldFoot({free, toe, sourceAnkle, sourceToe, length}, contacts, secondsPerFrame));
}

void CStandPlan::LandLeg(size_t leg, const std::vector<float>& landed, double secondsPerFrame)
{
    std::vector<float> free;
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
        free.push_back(FreeSole(leg, frame));
    const std::vector<double> soles = LandFoot(free, landed, secondsPerFrame);
    m_kLanded.push_back(landed);
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
        m_kAnkles[leg][frame].y = static_cast<float>(soles[frame]) + legs_[leg].At(frame).sole;
}

// A leg that is longer than the way to its ankle by some length wants its hip higher by as much, or by more
// where it slants, and less firmly. A bent knee takes most of it in its stride; a sole that would hang over
// the floor or lie below it does not.
void CStandPlan::AddWish(size_t leg, size_t frame, CBandFit& lifts) const
{
    const LegLengths& lengths = legs_[leg].Lengths();
    const Vec3 way = m_kAnkles[leg][frame] - m_kRoots[frame] - legs_[leg].At(frame).hip;
    const double distance = Vec3Length(way);
    const double bend = legs_[leg].KneeBend(frame);
    const double yielded = YieldingBend(lengths, distance, bend, kLimbStiffness);
    const double slope = SquareSlopeAt(lengths, 0.5 * (bend + yielded)) / (kLimbStiffness * kLimbStiffness);
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

Vec3 CStandPlan::Ankle(size_t leg, size_t frame) const
{
    if (m_kAnkles.empty())
        return legs_[leg].Stretch(frame);
    const Vec3 asked = m_kAnkles[leg][frame] - m_kRoots[frame] - legs_[leg].At(frame).hip;
    const double distance = Vec3Length(asked);
    const LegLengths& lengths = legs_[leg].Lengths();
    const double bend = YieldingBend(lengths, distance, legs_[leg].KneeBend(frame), kLimbStiffness);
    return asked * static_cast<float>(ReachAt(lengths, bend) / distance);
}

} // namespace gw
