// When a hand rests on a thigh, claps, or leans on the floor, what a viewer sees is the gap between the two.
// On a target with longer arms, the same bone directions put the hand past the thigh or inside it. So the gap
// is kept, and nothing else: the hand may end up farther up or down the thigh.
//
// Of all poses with the right gap, the wanted one is closest to the source's directions of upper arm and
// forearm, which is what a viewer sees of an arm that touches nothing. So an arm is moved by angles. If all
// of it rotates by w about its shoulder, so do both of its bones; if the elbow bends by b, each of them
// rotates by about b / 2. The sum of the squares for both bones is 2 w^2 + b^2 / 2. This weighs what a hand's
// path in millimeters would not: near the straight arm, a few millimeters toward the shoulder take many
// degrees, and a straight arm gets no longer. Where that is not enough, because the target's trunk is long
// and the hand hangs above the thigh, the collar bone gives way and lowers the shoulder, as a person's does.
//
// Thighs and trunk are segments, the head and the other hand are points, and the floor is a height. The gap
// is the hand's distance from the nearest point. Near things count more than far ones, a gap need only be
// right within a share of itself, and things far away do not count at all. One request per thing and sample
// asks for the distance, and least squares over all samples (CArmFit) fulfil them with smooth angles, which
// return to 0 between touches.
//
// A distance is not linear in the angles, so a few rounds of Newton's method each start from the hands of the
// last one. Seen from a point at the distance d, a hand that moves sideways by s gets farther away by
// s^2 / (2 d). If the hand is too far, at d instead of r, this adds a request not to move sideways, with the
// weight (d - r) / d. Without it, a hand whose arm is too short is thrown from side to side. Each hand takes
// half of what is wrong between the two, and the rounds bring them together.

#include "CHandPlan.h"

#include "CBandFit.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <optional>

namespace gw {

namespace {

// In millimeters of the target. A gap is the distance minus the thickness of the thing.
constexpr double kTouch = 50.0; // up to this gap, a touch counts in full, apart from kNear
constexpr double kNear = 50.0;  // the factor for near gaps is 1/2 at this gap
constexpr double kFade = 7.0;   // over this distance beyond kTouch, a touch fades out
constexpr double kThigh = 40.0; // thickness: from the middle of a thing to a wrist that lies on it
constexpr double kTrunk = 60.0;
constexpr double kHead = 70.0;
constexpr double kHand = 40.0;
constexpr double kFloor = 30.0;
constexpr float kHeadMiddle = 107.0f; // from the head's joint, in the direction of the target's neck
constexpr double kOnFloor = 20.0;     // the goal of a wrist is never lower
constexpr double kLowHand = 300.0;    // if the source's hand is higher, the target's is not below the floor

// A gap is right if it is wrong by this at most, plus this share of it, plus all that it exceeds kTouch.
constexpr double kRightGap = 4.0;
constexpr double kRightShare = 0.2;

// A gap that is wrong by this much costs as much as bones that are off by a radian.
constexpr double kGapScale = 26.0;
// Of the rotation vector, the elbow's bend, and the shoulder's shift upward.
constexpr CArmFit::Values kArmScales = {2.0, 2.0, 2.0, 0.5, 1.5};
constexpr double kHandHertz = 5.0; // arms swing past a thigh fast: the turn must be gone before the hand is
constexpr double kReturnSeconds = 0.3;      // after a touch, until an arm is back in its own pose
constexpr double kSecondsPerSample = 0.034; // enough to follow kHandHertz closely

// Rounds of Newton's method: at most, and the largest step of a hand in millimeters that needs no further
// one.
constexpr int kHandRounds = 6;
constexpr double kLastStep = 8.0;
// Weight of the last round's angles, which keeps a round from overshooting, against 1 for the arm's own pose.
constexpr double kInertia = 1.0;

// In the first round, the weight of the side of a thing on which the source's hand is, against 1 for the side
// of the free hand. Later rounds keep the side.
constexpr float kSourceSide = 0.25f;
// The elbow's angle in radians at which the slope of a straighter arm is taken when it must fold. At 0, there
// is none.
constexpr double kFoldingElbow = 0.3;

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
    double Distance(const Vec3& point) const { return Vec3Length(point - Nearest(point)); }
    bool IsInside(const Vec3& nearest) const { return nearest != from && nearest != to; }
};

struct Thing
{
    Segment source;
    Segment target;
    double thickness;
};

Vec3 HipMiddle(const TouchPoints& body)
{
    return (body.hips[0] + body.hips[1]) * 0.5f;
}

// The center of the head is where the target's neck points, on both sides. How the head rests on the source's
// neck has been corrected before.
std::array<Thing, 4> ThingsOf(const TouchPoints& source, const TouchPoints& target)
{
    const Vec3 middle = Vec3Normalized(target.head - target.neck) * kHeadMiddle;
    const Vec3 sourceHead = source.head + middle;
    const Vec3 targetHead = target.head + middle;
    return {
        {{{source.hips[0], source.knees[0]}, {target.hips[0], target.knees[0]}, kThigh},
         {{source.hips[1], source.knees[1]}, {target.hips[1], target.knees[1]}, kThigh},
         {{HipMiddle(source), source.neck}, {HipMiddle(target), target.neck}, kTrunk},
         {{sourceHead, sourceHead}, {targetHead, targetHead}, kHead}}
    };
}

// Returns the weight of a gap. Close ones count more than the many that are just close enough to count.
double WeightOf(double distance, double thickness)
{
    const double gap = distance - thickness;
    return (1.0 - Smoothstep((gap - kTouch) / kFade)) * kNear / (kNear + std::max(gap, 0.0));
}

bool IsNear(double distance, double thickness)
{
    return distance - thickness < kTouch + kFade;
}

// Returns the right distance that is nearest to a given one.
double RightDistance(double distance, double source, double thickness)
{
    const double gap = std::max(source - thickness, 0.0);
    const double slack = kRightGap + kRightShare * gap + std::max(gap - kTouch, 0.0);
    const double least = std::max(source - slack, 0.0);
    return std::clamp(distance, least, std::max(source + slack, least)); // a height can be below the floor
}

// Adds an arm's requests of one sample to the fit.
class CArmRequests
{
public:
    CArmRequests(CArmFit& fit, size_t sample, const LegLengths& arm, const ArmPoints& target,
                 const ArmPoints& moved, size_t side, const CArmFit::Values& now)
        : fit_(fit), m_uiSample(sample), arm_(arm), up_(target.chestUp), now_(now),
          m_kArm(moved.hands[side] - moved.shoulders[side]), m_kLine(Vec3Normalized(m_kArm)),
          m_fElbow(ElbowAt(arm, Vec3Length(m_kArm))), m_fSlope(SlopeAt(m_fElbow)),
          m_fCollar(Vec3Length(target.shoulders[side] - target.collars[side]))
    {
    }

    // Asks the hand to move farther in the direction of a unit vector.
    void Ask(double weight, const Vec3& direction, double farther) const
    {
        const double along = Vec3Dot(direction, m_kLine);
        const double slope = farther * along < 0.0 ? SlopeAt(std::hypot(m_fElbow, kFoldingElbow)) : m_fSlope;
        const Vec3 lever = Vec3Cross(m_kArm, direction);
        const CArmFit::Values coefficients = {lever.x, lever.y, lever.z, along * slope,
                                              Vec3Dot(direction, up_) * m_fCollar};
        const double now = std::inner_product(now_.begin(), now_.end(), coefficients.begin(), 0.0);
        fit_.AddRequest(m_uiSample, weight / (kGapScale * kGapScale), coefficients, now + farther);
    }

    // Asks for a distance from a line with the direction `axis`, or from a point if the axis is zero. `way`
    // is the vector to the hand, and `direction` the unit vector along which it moves.
    void AskDistance(double weight, const Vec3& way, const Vec3& direction, double distance,
                     const Vec3& axis) const
    {
        const double now = Vec3Dot(direction, way);
        Ask(weight, direction, distance - now);
        const double sideways = (now - distance) / std::max(now, 1.0) * weight;
        if (!(sideways > 0.0))
            return;
        const Vec3 across =
            Vec3Normalized(Vec3Cross(axis == kVec3Zero ? NotAlong(direction) : axis, direction));
        Ask(sideways, across, -Vec3Dot(across, way));
        if (axis == kVec3Zero)
        {
            const Vec3 other = Vec3Cross(across, direction);
            Ask(sideways, other, -Vec3Dot(other, way));
        }
    }

private:
    // Returns how far the hand moves along the arm per radian of the elbow.
    double SlopeAt(double elbow) const
    {
        return -arm_.upper * arm_.lower * std::sin(elbow) / std::max(ReachAtElbow(arm_, elbow), 1.0);
    }
    static Vec3 NotAlong(const Vec3& direction)
    {
        return std::fabs(direction.y) < 0.8f ? kVec3UnitY : kVec3UnitX;
    }

    CArmFit& fit_;
    size_t m_uiSample;
    const LegLengths& arm_;
    const Vec3& up_;
    const CArmFit::Values& now_;
    Vec3 m_kArm;
    Vec3 m_kLine;
    double m_fElbow;
    double m_fSlope;
    double m_fCollar;
};

ArmTurn TurnOf(const CArmFit::Values& values)
{
    const auto& [x, y, z, bend, raise] = values;
    return {
        {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)},
        bend, raise
    };
}

} // namespace

CHandPlan::CHandPlan(const std::array<LegLengths, 2>& arms, size_t frameCount, double secondsPerFrame,
                     bool hasFloor)
    : m_kArms(arms), m_uiFrameCount(frameCount),
      m_uiStep(static_cast<size_t>(std::clamp(kSecondsPerSample / secondsPerFrame, 1.0, 1e6))),
      m_fSecondsPerSample(secondsPerFrame * static_cast<double>(m_uiStep)), m_bHasFloor(hasFloor)
{
    const size_t sampleCount = frameCount == 0 ? 0 : (frameCount + m_uiStep - 2) / m_uiStep + 1;
    m_kValues.fill(std::vector<CArmFit::Values>(sampleCount, CArmFit::Values{}));
}

size_t CHandPlan::FrameOf(size_t sample) const
{
    return std::min(sample * m_uiStep, m_uiFrameCount - 1);
}

bool CHandPlan::Touches(const TouchPoints& source) const
{
    if (IsNear(Vec3Length(source.hands[0] - source.hands[1]), kHand))
        return true;
    const auto things = ThingsOf(source, source);
    return std::ranges::any_of(source.hands, [&](const Vec3& hand) {
        return (m_bHasFloor && static_cast<double>(hand.y) < kLowHand) ||
               IsNear(Vec3Length(hand - source.head), kHead + static_cast<double>(kHeadMiddle)) ||
               std::ranges::any_of(things, [&](const Thing& thing) {
                   return IsNear(thing.source.Distance(hand), thing.thickness);
               });
    });
}

void CHandPlan::Add(size_t sample, const TouchPoints& source, const ArmPoints& target)
{
    m_kPoses.push_back({sample, source, target, target});
}

std::vector<CHandPlan::Run> CHandPlan::Runs() const
{
    const auto margin = static_cast<size_t>(kReturnSeconds / m_fSecondsPerSample) + 1;
    std::vector<Run> runs;
    for (size_t i = 0; i < m_kPoses.size(); ++i)
    {
        const size_t sample = m_kPoses[i].sample;
        if (runs.empty() || sample >= runs.back().endSample + margin)
            runs.push_back({i, i, sample - std::min(sample, margin), sample});
        runs.back().endPose = i + 1;
        runs.back().endSample = std::min(sample + margin + 1, SampleCount());
    }
    return runs;
}

// Returns whether there are any.
bool CHandPlan::AddRequests(CArmFit& fit, size_t sample, const Pose& pose, size_t side,
                            bool fromSourceSide) const
{
    const Vec3& hand = pose.moved.hands[side];
    const Vec3& sourceHand = pose.source.hands[side];
    std::optional<CArmRequests> made; // in most poses, at most one of the hands is near anything
    const auto arm = [&]() -> const CArmRequests& {
        return made ? *made
                    : made.emplace(fit, sample, m_kArms[side], pose.target, pose.moved, side,
                                   m_kValues[side][pose.sample]);
    };
    const auto ask = [&](const Vec3& sourceWay, const Vec3& way, double thickness, double share,
                         const Vec3& axis) {
        const double sourceDistance = Vec3Length(sourceWay);
        const Vec3 direction = Vec3Normalized(fromSourceSide ? way + sourceWay * kSourceSide : way);
        const double now = Vec3Dot(direction, way);
        const double right = RightDistance(now, sourceDistance, thickness);
        arm().AskDistance(WeightOf(sourceDistance, thickness), way, direction, now + (right - now) * share,
                          axis);
    };
    for (const Thing& thing : ThingsOf(pose.source, pose.target))
    {
        const Vec3 sourceWay = sourceHand - thing.source.Nearest(sourceHand);
        if (!IsNear(Vec3Length(sourceWay), thing.thickness))
            continue;
        const Vec3 nearest = thing.target.Nearest(hand);
        ask(sourceWay, hand - nearest, thing.thickness, 1.0,
            thing.target.IsInside(nearest) ? thing.target.to - thing.target.from : kVec3Zero);
    }
    const Vec3 sourceApart = sourceHand - pose.source.hands[1 - side];
    if (IsNear(Vec3Length(sourceApart), kHand))
        ask(sourceApart, hand - pose.moved.hands[1 - side], kHand, 0.5, kVec3Zero);

    const auto height = static_cast<double>(hand.y);
    const auto sourceHeight = static_cast<double>(sourceHand.y);
    const double weight = m_bHasFloor ? WeightOf(sourceHeight, kFloor) : 0.0;
    if (weight > 0.0)
        arm().Ask(weight, kVec3UnitY,
                  std::max(RightDistance(height, sourceHeight, kFloor), kOnFloor) - height);
    else if (m_bHasFloor && static_cast<double>(pose.target.hands[side].y) < kOnFloor)
        arm().Ask(1.0, kVec3UnitY, std::max(kOnFloor - height, 0.0));
    return made.has_value();
}

// Returns whether the hand is near anything.
bool CHandPlan::Fit(const Run& run, size_t side, bool fromSourceSide)
{
    CArmFit fit(run.endSample - run.firstSample, kArmScales, BendWeight(kHandHertz, m_fSecondsPerSample));
    bool any = false;
    for (size_t i = run.firstPose; i < run.endPose; ++i)
    {
        const Pose& pose = m_kPoses[i];
        if (!fromSourceSide)
            fit.AddPull(pose.sample - run.firstSample, kInertia, m_kValues[side][pose.sample]);
        any |= AddRequests(fit, pose.sample - run.firstSample, pose, side, fromSourceSide);
    }
    if (any)
        std::ranges::copy(fit.Solve(),
                          m_kValues[side].begin() + static_cast<std::ptrdiff_t>(run.firstSample));
    return any;
}

// Returns how far the hand moves.
double CHandPlan::Move(Pose& pose, size_t side) const
{
    const Vec3 before = pose.moved.hands[side];
    const ArmTurn turn = TurnOf(m_kValues[side][pose.sample]);
    const Vec3& collar = pose.target.collars[side];
    const Vec3& shoulder = pose.target.shoulders[side];
    pose.moved.shoulders[side] = collar + TurnedCollar(shoulder - collar, pose.target.chestUp, turn);
    pose.moved.hands[side] =
        pose.moved.shoulders[side] + TurnedHand(m_kArms[side], pose.target.hands[side] - shoulder, turn);
    return Vec3Length(pose.moved.hands[side] - before);
}

void CHandPlan::Solve()
{
    for (const Run& run : Runs())
    {
        double step = 0.0;
        std::array<bool, 2> moves = {true, true}; // a hand that is near nothing is done after the first round
        for (int round = 0; round == 0 || (round < kHandRounds && step > kLastStep); ++round)
        {
            step = 0.0;
            std::array<bool, 2> fits{};
            for (size_t side = 0; side < m_kValues.size(); ++side)
                fits[side] = moves[side] && Fit(run, side, round == 0);
            for (size_t i = run.firstPose; i < run.endPose; ++i)
            {
                for (size_t side = 0; side < m_kValues.size(); ++side)
                    step = moves[side] ? std::max(step, Move(m_kPoses[i], side)) : step;
            }
            moves = fits;
        }
    }
    m_kPoses.clear();
}

// Between samples, the curves are cubics with the slopes that lie between the neighbors of both ends (Catmull
// and Rom).
ArmTurn CHandPlan::Turn(size_t side, size_t frame) const
{
    const std::vector<CArmFit::Values>& values = m_kValues[side];
    const size_t sample = frame / m_uiStep;
    const double t = static_cast<double>(frame % m_uiStep) / static_cast<double>(m_uiStep);
    if (t == 0.0)
        return TurnOf(values[sample]);
    const CArmFit::Values& before = values[sample > 0 ? sample - 1 : 0];
    const CArmFit::Values& from = values[sample];
    const CArmFit::Values& to = values[sample + 1];
    const CArmFit::Values& after = values[std::min(sample + 2, values.size() - 1)];
    CArmFit::Values between{};
    for (size_t i = 0; i < between.size(); ++i)
    {
        const double slope = 0.5 * (to[i] - before[i]);
        const double slopeAtEnd = 0.5 * (after[i] - from[i]);
        const double way = to[i] - from[i];
        between[i] =
            from[i] +
            t * (slope + t * (3.0 * way - 2.0 * slope - slopeAtEnd + t * (slope + slopeAtEnd - 2.0 * way)));
    }
    return TurnOf(between);
}

} // namespace gw
