#include "CFeetTrack.h"

#include "CPoseSampler.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

// Heights of a standing joint above its floor, in leg lengths. Up to the first, its sole is on the floor;
// from the second on, it hovers.
constexpr double kLowHeight = 0.02;
constexpr double kHoverHeight = 0.05;
// In leg lengths per second: at this speed, a foot is half settled.
constexpr double kSettledSpeed = 0.3;

} // namespace

float FloorOf(const std::vector<CLegTrack>& legs, const std::vector<Vec3>& (CLegTrack::*joint)() const)
{
    std::vector<float> heights;
    for (const CLegTrack& leg : legs)
        std::ranges::transform((leg.*joint)(), std::back_inserter(heights), &Vec3::y);
    return Percentile(std::move(heights), kFloorShare);
}

CFeetTrack::CFeetTrack(const std::vector<LegJoints>& legs)
{
    const double floor = RestFloor(legs);
    for (const LegJoints& leg : legs)
        m_kLegs.emplace_back(leg, floor);
}

void CFeetTrack::WatchJoints(CPoseSampler& sampler) const
{
    for (const CLegTrack& leg : m_kLegs)
        leg.WatchJoints(sampler);
}

void CFeetTrack::Append()
{
    for (CLegTrack& leg : m_kLegs)
        leg.Append();
}

void CFeetTrack::AppendPlaces()
{
    for (CLegTrack& leg : m_kLegs)
        leg.AppendPlaces();
}

void CFeetTrack::MeasureLegs()
{
    CRunningMean lengths;
    for (const CLegTrack& leg : m_kLegs)
        lengths.Add(leg.Length());
    m_fLegLength = lengths.Mean();
}

// Sets how surely the sole has landed. Without a frame in which ankle and toe stand together, a contact whose
// joints stay above the floor hovers.
void CFeetTrack::FindLanded(const FloorPath& ankle, const FloorPath& toe, FootTouches& touches) const
{
    for (const Contact& contact : touches.contacts)
    {
        double height = kHoverHeight;
        for (auto frame = static_cast<size_t>(contact.first); frame < static_cast<size_t>(contact.end);
             ++frame)
        {
            const float above =
                std::min(ankle.positions[frame].y - ankle.floor, toe.positions[frame].y - toe.floor);
            height = std::min(height, static_cast<double>(above) / m_fLegLength);
        }
        const bool isFlat = std::ranges::any_of(touches.flat, [&](const Contact& other) {
            return contact.first <= other.first && other.end <= contact.end;
        });
        const double hovers = isFlat ? 0.0 : Smoothstep((height - kLowHeight) / (kHoverHeight - kLowHeight));
        for (int frame = contact.first; frame < contact.end; ++frame)
            touches.states[static_cast<size_t>(frame)].landed = static_cast<float>(1.0 - hovers);
    }
}

FootTouches CFeetTrack::TouchesOf(const CLegTrack& leg, float ankleFloor, float toeFloor,
                                  double secondsPerFrame) const
{
    const FloorPath ankle{leg.Ankles(), ankleFloor};
    const FloorPath toe{leg.HasToe() ? leg.Toes() : leg.Ankles(), leg.HasToe() ? toeFloor : ankleFloor};
    const std::vector<FootMotion> ankleMotion = MotionOf(ankle, secondsPerFrame);
    const std::vector<FootMotion> toeMotion = leg.HasToe() ? MotionOf(toe, secondsPerFrame) : ankleMotion;
    const auto find = [&](const std::vector<FootMotion>& of) {
        return FindContacts(std::span<const FootMotion>(of), m_fLegLength, secondsPerFrame);
    };
    const std::vector<FootMotion> motion = JointMotion(ankleMotion, toeMotion);
    FootTouches touches;
    touches.ankle = find(ankleMotion);
    touches.toe = find(toeMotion);
    touches.contacts = MergedContacts(touches.ankle, touches.toe);
    touches.flat = find(motion);
    if (!leg.HasToe())
        touches.toe.clear();
    touches.states.resize(motion.size());
    FindLanded(ankle, toe, touches);
    for (size_t frame = 0; frame < motion.size(); ++frame)
    {
        FootState& state = touches.states[frame];
        const double speed = motion[frame].speed / m_fLegLength;
        const double height = motion[frame].height / m_fLegLength;
        const double low = std::min(ankleMotion[frame].height, toeMotion[frame].height) / m_fLegLength;
        const double moves = Smoothstep((speed - kStandSpeed) / (kLeaveSpeed - kStandSpeed));
        const double rises = Smoothstep((height - kHoverHeight) / (kStandHeight - kHoverHeight));
        state.settled = state.landed / static_cast<float>(1.0 + std::pow(speed / kSettledSpeed, 4.0));
        state.aloft = static_cast<float>((1.0 - moves) * rises);
        state.height = static_cast<float>(height);
        state.lowHeight = static_cast<float>(low);
        state.ankleHeight = static_cast<float>(ankleMotion[frame].height / m_fLegLength);
    }
    for (const Contact& contact : touches.flat)
    {
        for (int frame = contact.first; frame < contact.end; ++frame)
            touches.states[static_cast<size_t>(frame)].aloft = 0.0f;
    }
    return touches;
}

std::vector<FootTouches> CFeetTrack::Touches(double secondsPerFrame) const
{
    const float ankleFloor = FloorOf(m_kLegs, &CLegTrack::Ankles);
    const float toeFloor = FloorOf(m_kLegs, &CLegTrack::Toes);
    std::vector<FootTouches> touches;
    for (const CLegTrack& leg : m_kLegs)
        touches.push_back(TouchesOf(leg, ankleFloor, toeFloor, secondsPerFrame));
    return touches;
}

} // namespace gw
