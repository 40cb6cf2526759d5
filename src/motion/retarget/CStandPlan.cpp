// Feet that stand, hips that are as high as the source's and legs that point as the source's cannot all be
// had on a body of other proportions. What gives way is chosen by what an eye forgives: nobody sees that the
// hips go a centimetre higher, everybody that a knee jerks or a foot slides.
//
// So the source's directions give a base pose. Contacts hold the foot at the place where the base pose has it
// on average. The root is moved up and down, slowly, until legs that stand are as long as their base pose
// wants them. What is left over is the knee's, as far as it is bent and can take that without a jerk.

#include "CStandPlan.h"

#include "Figures.h"
#include "Play.h"
#include "SmoothCurve.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Lengths are millimetres of the target.
constexpr double kSwayPlay = 10.0;      // of the hips below the root, which costs a leg less than a degree
constexpr double kSwaySeconds = 1.0;    // a step sways faster, a body that kneels more slowly
constexpr double kDriftPlay = 15.0;     // a foot that drifts over 3 cm in a contact is being dragged
constexpr double kFadeSeconds = 0.12;   // a heel peels off in about as long
constexpr double kFloorBlend = 16.0;    // twice of what a swinging sole may dip
constexpr double kLiftSeconds = 0.15;   // a step takes four times as long
constexpr double kLiftLimit = 100.0;    // a source that asks for more does not stand on one floor
constexpr int kLiftRounds = 2;          // the second one is for legs that the first left out of reach
constexpr double kStiffness = 25.0;     // a knee bent by less than 8 degrees is kept rather than the foot
constexpr double kLeastFirmness = 0.02; // where legs hardly stand, nothing pulls at the root

// What is held of a foot lies this far from ankle to toe: a heel that comes up turns it about the toe.
constexpr float kHeldShare = 0.25f;

Vec3 OverGround(const Vec3& way)
{
    return {way.x, 0.0f, way.z};
}

// The height of a sole that swings: as its leg has it over the floor, and below led back smoothly, by half
// of the blend at the deepest. On a foot longer than the source's a toe that pushes off would lift the leg.
double AboveFloor(double height)
{
    const double below = std::clamp(-height, 0.0, kFloorBlend);
    return std::max(height, -kFloorBlend) + below * below / (2.0 * kFloorBlend);
}

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
      m_kRoots(source.FrameCount(), kVec3Zero)
{
    const ContactsOfLegs contacts = source.Contacts(secondsPerFrame);
    PlaceRoot(origin, secondsPerFrame);
    StandOnFloor(contacts);
    if (!holdFeet)
        return;
    for (size_t leg = 0; leg < legs_.size(); ++leg)
        m_kHolds.push_back(HoldFoot({FreePath(leg), SourcePath(leg), m_fScale}, contacts[leg], kDriftPlay,
                                    kFadeSeconds / secondsPerFrame));
    std::vector<float> lifts(m_kRoots.size(), 0.0f);
    for (int round = 0; round < kLiftRounds; ++round)
        LiftRoot(kLiftSeconds / secondsPerFrame, lifts);
}

// What the hips' place below the root differs from the source's by.
Vec3 CStandPlan::Sway(size_t frame) const
{
    Vec3 hips = kVec3Zero;
    for (const CFaithfulLeg& leg : legs_)
        hips = hips + leg.At(frame).hip * (1.0f / static_cast<float>(legs_.size()));
    return (source_.Hips(frame) - source_.Root(frame)) * static_cast<float>(m_fScale) - hips;
}

// How far the root is led over the ground by hips that sway below it. The target's root lies higher over its
// hips than a source's, so that they swing as the pelvis turns. In a step legs that stand can take that, and
// must: it would lengthen the root's way. A body that kneels or bows takes its root along.
std::vector<Vec3> CStandPlan::SwayLead(double smoothFrames) const
{
    std::vector<float> x;
    std::vector<float> z;
    CRunningMean meanX;
    CRunningMean meanZ;
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        const Vec3 sway = Sway(frame);
        meanX.Add(static_cast<double>(sway.x));
        meanZ.Add(static_cast<double>(sway.z));
        x.push_back(sway.x);
        z.push_back(sway.z);
    }
    const Vec3 mean{static_cast<float>(meanX.Mean()), 0.0f, static_cast<float>(meanZ.Mean())};
    for (size_t frame = 0; frame < x.size(); ++frame)
    {
        const Vec3 lead = BeyondPlay(Vec3{x[frame], 0.0f, z[frame]} - mean, kSwayPlay);
        x[frame] = std::isfinite(lead.x) ? lead.x : 0.0f;
        z[frame] = std::isfinite(lead.z) ? lead.z : 0.0f;
    }
    SmoothCurve(x, smoothFrames);
    SmoothCurve(z, smoothFrames);
    std::vector<Vec3> leads;
    for (size_t frame = 0; frame < x.size(); ++frame)
        leads.push_back({x[frame], 0.0f, z[frame]});
    return leads;
}

// Over the ground the root goes the source's way, up and down the middle of the hips does.
void CStandPlan::PlaceRoot(const Vec3& origin, double secondsPerFrame)
{
    m_kRoots = SwayLead(kSwaySeconds / secondsPerFrame);
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        Vec3 way = (source_.Root(frame) - source_.Root(0)) * static_cast<float>(m_fScale);
        way.y += Sway(frame).y;
        m_kRoots[frame] = m_kRoots[frame] + way;
    }
    const Vec3 shift = m_kRoots.empty() ? kVec3Zero : OverGround(origin - m_kRoots.front());
    for (Vec3& root : m_kRoots)
        root = root + shift;
}

// How much higher the root must be for the sole of a leg in its base pose to lie on the floor.
float CStandPlan::Lift(size_t leg, size_t frame) const
{
    const CFaithfulLeg::Frame& at = legs_[leg].At(frame);
    return at.sole - (m_kRoots[frame] + at.hip + legs_[leg].Stretch(frame)).y;
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
                standing.push_back(Lift(leg, static_cast<size_t>(frame)));
        }
        for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
            all.push_back(Lift(leg, frame));
    }
    const float lift = standing.empty() ? Percentile(std::move(all), 1.0 - kFloorShare)
                                        : Percentile(std::move(standing), 0.5);
    for (Vec3& root : m_kRoots)
        root.y += lift;
}

// The way of what is held of a foot, with its leg in the base pose.
std::vector<Vec3> CStandPlan::FreePath(size_t leg) const
{
    std::vector<Vec3> path;
    path.reserve(m_kRoots.size());
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        const CFaithfulLeg::Frame& at = legs_[leg].At(frame);
        path.push_back(m_kRoots[frame] + at.hip + legs_[leg].Stretch(frame) + at.toe * kHeldShare);
    }
    return path;
}

std::vector<Vec3> CStandPlan::SourcePath(size_t leg) const
{
    const CLegTrack& track = source_.Leg(leg);
    std::vector<Vec3> path = track.Ankles();
    for (size_t frame = 0; frame < track.Toes().size(); ++frame)
        path[frame] = path[frame] + (track.Toes()[frame] - path[frame]) * kHeldShare;
    return path;
}

// Where the ankle is to be, from the hip, whether the leg reaches it or not.
Vec3 CStandPlan::AskedAnkle(size_t leg, size_t frame) const
{
    const CFaithfulLeg::Frame& at = legs_[leg].At(frame);
    const FootHold& hold = m_kHolds[leg][frame];
    const Vec3 hip = m_kRoots[frame] + at.hip;
    const Vec3 stretch = legs_[leg].Stretch(frame);
    Vec3 ankle = stretch + (hold.place - hip - stretch - at.toe * kHeldShare) * hold.share;
    const double sole = AboveFloor(static_cast<double>(hip.y + stretch.y - at.sole));
    ankle.y = static_cast<float>((1.0 - static_cast<double>(hold.share)) * sole) + at.sole - hip.y;
    return ankle;
}

Vec3 CStandPlan::Ankle(size_t leg, size_t frame) const
{
    if (m_kHolds.empty())
        return legs_[leg].Stretch(frame);
    const Vec3 asked = AskedAnkle(leg, frame);
    const double distance = Vec3Length(asked);
    const double reach =
        YieldingReach(legs_[leg].Lengths(), distance, legs_[leg].KneeAngle(frame), kStiffness);
    return asked * static_cast<float>(reach / distance);
}

// A leg that is asked for another reach than it yields to pulls at the root by the difference, and the more
// firmly the less its knee takes off.
void CStandPlan::AddPull(size_t leg, size_t frame, Pull& pull) const
{
    const Vec3 asked = AskedAnkle(leg, frame);
    const double distance = Vec3Length(asked);
    const double reach = Vec3Length(Ankle(leg, frame));
    const LegLengths& lengths = legs_[leg].Lengths();
    const double slope = ReachSlope(lengths, AngleAt(lengths, reach)) / kStiffness;
    const double upright = static_cast<double>(-asked.y) / distance;
    const auto share = static_cast<double>(m_kHolds[leg][frame].share);
    if (!std::isfinite(upright * reach))
        return;
    pull.force[frame] += static_cast<float>(share * upright * (reach - distance));
    pull.firmness[frame] += static_cast<float>(share * upright * upright / (slope * slope + 1.0));
}

// One of Newton's steps towards the heights at which legs that stand need the least of their knees and feet.
// `lifts` is what the steps before have done.
void CStandPlan::LiftRoot(double smoothFrames, std::vector<float>& lifts)
{
    Pull pull{std::vector<float>(m_kRoots.size(), 0.0f), std::vector<float>(m_kRoots.size(), 0.0f)};
    for (size_t leg = 0; leg < legs_.size(); ++leg)
    {
        for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
            AddPull(leg, frame, pull);
    }
    SmoothCurve(pull.force, smoothFrames);
    SmoothCurve(pull.firmness, smoothFrames);
    for (size_t frame = 0; frame < m_kRoots.size(); ++frame)
    {
        const double step = static_cast<double>(pull.force[frame]) /
                            (static_cast<double>(pull.firmness[frame]) + kLeastFirmness);
        const auto lift =
            static_cast<float>(std::clamp(static_cast<double>(lifts[frame]) + step, -kLiftLimit, kLiftLimit));
        m_kRoots[frame].y += lift - lifts[frame];
        lifts[frame] = lift;
    }
}

} // namespace gw
