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

void CFeetTrack::FindAloft(const std::vector<FootMotion>& motion, FootTouches& touches) const
{
    for (const FootMotion& of : motion)
    {
        const double height = of.height / m_fLegLength;
        const double moves =
            Smoothstep((of.speed / m_fLegLength - kStandSpeed) / (kLeaveSpeed - kStandSpeed));
        const double rises = Smoothstep((height - kHoverHeight) / (kStandHeight - kHoverHeight));
        touches.aloft.push_back(static_cast<float>((1.0 - moves) * rises));
        touches.heights.push_back(static_cast<float>(height));
    }
    for (const Contact& contact : touches.flat)
        std::fill(touches.aloft.begin() + contact.first, touches.aloft.begin() + contact.end, 0.0f);
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
    touches.landed.assign(ankle.positions.size(), 0.0f);
    touches.flat = find(motion);
    FindAloft(motion, touches);
    if (!leg.HasToe())
        touches.toe.clear();
    for (const Contact& contact : touches.contacts)
    {
        double height = kHoverHeight;
        for (auto frame = static_cast<size_t>(contact.first); frame < static_cast<size_t>(contact.end);
             ++frame)
        {
            const float above =
                std::min(ankle.positions[frame].y - ankleFloor, toe.positions[frame].y - toe.floor);
            height = std::min(height, static_cast<double>(above) / m_fLegLength);
        }
        const bool isFlat = std::ranges::any_of(touches.flat, [&](const Contact& other) {
            return contact.first <= other.first && other.end <= contact.end;
        });
        const double hovers = isFlat ? 0.0 : Smoothstep((height - kLowHeight) / (kHoverHeight - kLowHeight));
        std::fill(touches.landed.begin() + contact.first, touches.landed.begin() + contact.end,
                  static_cast<float>(1.0 - hovers));
    }
    for (size_t frame = 0; frame < motion.size(); ++frame)
    {
        const double speed = motion[frame].speed / (kSettledSpeed * m_fLegLength);
        touches.settled.push_back(touches.landed[frame] / static_cast<float>(1.0 + std::pow(speed, 4.0)));
        const double low = std::min(ankleMotion[frame].height, toeMotion[frame].height);
        touches.lowHeights.push_back(static_cast<float>(low / m_fLegLength));
        touches.ankleHeights.push_back(static_cast<float>(ankleMotion[frame].height / m_fLegLength));
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
