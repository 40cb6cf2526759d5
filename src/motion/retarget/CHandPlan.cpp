// When a hand rests on a thigh, claps, or leans on the floor, what a viewer sees is the gap between the two.
// On a target with longer arms, the same bone directions put the hand past the thigh or inside it. So the gap
// is kept, and nothing else: the hand may end up farther up or down the thigh.
//
// Thighs and trunk are segments. In the source, n is the vector from the nearest point of the segment to the
// hand. In the target, the goal starts at the point of its segment that is nearest to the free hand. From
// there it is as far away as n is long, in a direction between the free hand's and n, made perpendicular to
// the segment unless the nearest point is one of its ends. The head and the other hand are points, and the
// floor is a height. Near things count more than far ones, and things out of reach do not count at all.
// Between touches, least squares over all frames bring the hand back to its free path, as for feet
// (CBandFit).

#include "CHandPlan.h"

#include "Directions.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// In millimeters of the target. A gap is the distance minus the thickness of the thing.
constexpr double kTouch = 30.0; // up to this gap, a touch counts in full, apart from kNear
constexpr double kNear = 50.0;  // the factor for near gaps is 1/2 at this gap, before it is squared
constexpr double kFade = 20.0;  // over this distance beyond kTouch, a touch fades out
constexpr double kThigh = 50.0; // thickness: from the middle of a thing to a wrist that lies on it
constexpr double kTrunk = 60.0;
constexpr double kHead = 80.0;
constexpr double kHand = 50.0;
constexpr double kFloor = 40.0;
constexpr double kOnFloor = 20.0; // the goal of a wrist is never lower

constexpr double kTouchWeight = 60.0; // weight of a hand that touches; its free path has weight 1
constexpr double kHandHertz = 4.0; // arms swing past a thigh fast: the shift must be gone before the hand is

// Rounds of the search for a goal within reach. Most goals are, and need none.
constexpr int kReachRounds = 20;

// Weight of the side of a thing on which the source's hand is, against 1 for the side of the free hand.
constexpr float kSourceSide = 0.25f;

struct Segment
{
    Vec3 from;
    Vec3 to;

    Vec3 Nearest(const Vec3& point) const
    {
        const Vec3 way = to - from;
        const double square = Vec3Dot(way, way);
        const double share = square > 0.0 ? Vec3Dot(point - from, way) / square : 0.0;
        return from + way * static_cast<float>(std::clamp(share, 0.0, 1.0));
    }
    bool IsInside(const Vec3& nearest) const { return nearest != from && nearest != to; }
};

Vec3 HipMiddle(const TouchPoints& body)
{
    return (body.hips[0] + body.hips[1]) * 0.5f;
}

// Returns the weight of a gap. Close ones count more than the many that are just close enough to count.
double WeightOf(double distance, double thickness)
{
    const double gap = distance - thickness;
    const double near = kNear / (kNear + std::max(gap, 0.0));
    return (1.0 - Smoothstep((gap - kTouch) / kFade)) * near * near;
}

// Returns a hand's goal for one segment: at the source's distance, on a side between the hand's own and the
// source's.
Vec3 WantedAt(const Segment& source, const Segment& target, const Vec3& sourceHand, const Vec3& hand)
{
    const Vec3 way = sourceHand - source.Nearest(sourceHand);
    const Vec3 nearest = target.Nearest(hand);
    Vec3 side = hand - nearest + way * kSourceSide;
    if (target.IsInside(nearest))
        side = Across(side, Vec3Normalized(target.to - target.from));
    return nearest + Vec3Normalized(side) * static_cast<float>(Vec3Length(way));
}

struct Thing
{
    Segment source;
    Segment target;
    double thickness;
};

std::array<Thing, 4> ThingsOf(const TouchPoints& source, const TouchPoints& target)
{
    return {
        {{{source.hips[0], source.knees[0]}, {target.hips[0], target.knees[0]}, kThigh},
         {{source.hips[1], source.knees[1]}, {target.hips[1], target.knees[1]}, kThigh},
         {{HipMiddle(source), source.neck}, {HipMiddle(target), target.neck}, kTrunk},
         {{source.head, source.head}, {target.head, target.head}, kHead}}
    };
}

// Returns a hand's goal for one thing that it can reach. A goal out of reach is pulled back to the arm's
// reach and then to the thing's distance again, alternately, so that it moves along the thing.
Vec3 GoalAt(const Thing& thing, const TouchPoints& source, const TouchPoints& target, size_t side)
{
    Vec3 goal = WantedAt(thing.source, thing.target, source.hands[side], target.hands[side]);
    for (int round = 0; round < kReachRounds; ++round)
    {
        const Vec3 way = goal - target.shoulders[side];
        const double distance = Vec3Length(way);
        if (distance <= target.reach[side] || thing.target.from == thing.target.to)
            break; // nothing can be gained along a point
        goal = WantedAt(thing.source, thing.target, source.hands[side],
                        target.shoulders[side] + way * static_cast<float>(target.reach[side] / distance));
    }
    return goal;
}

double Distance(const Segment& segment, const Vec3& point)
{
    return Vec3Length(point - segment.Nearest(point));
}

} // namespace

CHandPlan::CHandPlan(size_t frameCount, double secondsPerFrame, bool hasFloor) : m_bHasFloor(hasFloor)
{
    const CBandFit free(frameCount, BendWeight(kHandHertz, secondsPerFrame), 1.0);
    m_kFits.assign(2, {free, free, free});
}

bool CHandPlan::Touches(const TouchPoints& source) const
{
    const auto isNear = [](double distance, double thickness) { return WeightOf(distance, thickness) > 0.0; };
    if (isNear(Vec3Length(source.hands[0] - source.hands[1]), kHand))
        return true;
    return std::ranges::any_of(source.hands, [&](const Vec3& hand) {
        const auto things = ThingsOf(source, source);
        return (m_bHasFloor && isNear(static_cast<double>(hand.y), kFloor)) ||
               std::ranges::any_of(things, [&](const Thing& thing) {
                   return isNear(Distance(thing.source, hand), thing.thickness);
               });
    });
}

void CHandPlan::Pull(size_t side, size_t frame, double weight, const Vec3& way)
{
    m_kFits[side].x.AddValue(frame, kTouchWeight * weight, static_cast<double>(way.x));
    m_kFits[side].y.AddValue(frame, kTouchWeight * weight, static_cast<double>(way.y));
    m_kFits[side].z.AddValue(frame, kTouchWeight * weight, static_cast<double>(way.z));
}

void CHandPlan::Add(size_t frame, const TouchPoints& source, const TouchPoints& target)
{
    const Vec3 between = source.hands[0] - source.hands[1];
    const Vec3 apart = (target.hands[0] - target.hands[1] - between) * 0.5f;
    const double clasp = WeightOf(Vec3Length(between), kHand);
    for (size_t side = 0; side < 2; ++side)
    {
        const Vec3& hand = target.hands[side];
        const Vec3& sourceHand = source.hands[side];
        for (const Thing& thing : ThingsOf(source, target))
        {
            const double weight = WeightOf(Distance(thing.source, sourceHand), thing.thickness);
            if (weight > 0.0)
                Pull(side, frame, weight, GoalAt(thing, source, target, side) - hand);
        }
        Pull(side, frame, clasp, side == 0 ? -apart : apart);
        if (!m_bHasFloor)
            continue;
        const auto height = static_cast<double>(sourceHand.y);
        m_kFits[side].y.AddValue(frame, kTouchWeight * WeightOf(height, kFloor),
                                 std::max(height, kOnFloor) - static_cast<double>(hand.y));
    }
}

void CHandPlan::Solve()
{
    for (size_t side = 0; side < 2; ++side)
    {
        const std::vector<double> x = m_kFits[side].x.Solve();
        const std::vector<double> y = m_kFits[side].y.Solve();
        const std::vector<double> z = m_kFits[side].z.Solve();
        for (size_t frame = 0; frame < x.size(); ++frame)
            m_kWays[side].push_back(
                {static_cast<float>(x[frame]), static_cast<float>(y[frame]), static_cast<float>(z[frame])});
    }
    m_kFits.clear();
}

} // namespace gw
