// A foot stands on its heel first, then flat, then on its ball while the heel comes up. If the foot has a
// different length, ankle and toe cannot both move like the source's. Let va and vt be their speeds in the
// source. Each requests its own steps with the weight w / (v^2 + e^2), where e is a speed at which a foot
// just stands. By least squares, the point at the fraction
//
//     u = wt (va^2 + e^2) / (wt (va^2 + e^2) + wa (vt^2 + e^2))
//
// of the line from ankle to toe moves like the source's. It is the joint that stands, or a point between the
// two while both stand. As the vector from ankle to toe changes, the foot rotates about this point.
//
// With equal weights wa and wt, a long foot that turns on the spot or peels off the floor slides with one
// joint by centimeters and not at all with the other. A viewer sees the one that slides. So the added slide
// of each joint is measured in each of its stands, and in the next round a joint that slides farther gets
// more weight there. Slides are about proportional to u and 1 - u, so weights that grow with the ratio of the
// slides converge in a few rounds to joints that slide equally far. Weights change smoothly in time.
//
// The source's foot may drift while it stands, because sensors drift and feet are dragged. The drift is
// measured at the point for a small e, which does not move while a foot rolls. A short drift is mostly
// removed, a long one mostly kept.

#include "StandSteps.h"

#include "Figures.h"
#include "SmoothCurve.h"

#include <algorithm>
#include <cmath>
#include <functional>

namespace gw {

namespace {

// In leg lengths per second.

constexpr double kStillSpeed = 0.12; // of a foot that certainly stands
constexpr double kDriftSpeed = 0.15; // of a foot that moves instead of drifting

constexpr double kSpeedBlend = 0.03;   // seconds over which the speeds and weights of the pivot are smoothed
constexpr double kDriftShare = 0.03;   // in leg lengths: half of a drift this long is kept
constexpr double kUnseenSlide = 0.003; // in leg lengths: hardly a reason to weight a joint more
constexpr double kWeightGain = 0.7;    // exponent of the ratio of slides; 1 would overshoot
constexpr int kWeightRounds = 2;

Vec3 Between(const Vec3& a, const Vec3& b, double share)
{
    return a + (b - a) * static_cast<float>(share);
}

// Returns the smoothed speed of a joint in each frame, in leg lengths per second. A jump has no speed.
std::vector<float> SpeedsOf(std::span<const Vec3> path, double leg, double secondsPerFrame,
                            std::span<const size_t> jumps)
{
    const auto isApart = [&](size_t frame) { return std::ranges::binary_search(jumps, frame); };
    std::vector<float> speeds;
    for (size_t frame = 0; frame < path.size(); ++frame)
    {
        const size_t before = frame > 0 && !isApart(frame - 1) ? frame - 1 : frame;
        const size_t after = frame + 1 < path.size() && !isApart(frame) ? frame + 1 : frame;
        const double seconds = static_cast<double>(std::max<size_t>(after - before, 1)) * secondsPerFrame;
        const double speed = Vec3Length(path[after] - path[before]) / (seconds * leg);
        speeds.push_back(std::isfinite(speed) ? static_cast<float>(speed) : 0.0f);
    }
    SmoothCurve(speeds, kSpeedBlend / secondsPerFrame);
    return speeds;
}

// The point of the source's foot that stands in each frame, and how it moves.
class CPivot
{
public:
    CPivot(const FootPaths& foot, double secondsPerFrame, std::span<const size_t> jumps)
        : foot_(foot), m_kAnkle(SpeedsOf(foot.sourceAnkle, foot.leg, secondsPerFrame, jumps)),
          m_kToe(SpeedsOf(foot.sourceToe, foot.leg, secondsPerFrame, jumps))
    {
    }
    /// Returns where the pivot is between a frame and the next: 0 at the ankle, 1 at the toe. `still` is e,
    /// `favor` wt / wa.
    double Share(size_t frame, double still, double favor = 1.0) const
    {
        const double ankle = SquareBetween(m_kAnkle, frame) + still * still;
        const double toe = SquareBetween(m_kToe, frame) + still * still;
        return favor * ankle / (favor * ankle + toe);
    }
    /// Returns the horizontal step of the source's foot from a frame to the next, at a fraction of the line
    /// from ankle to toe.
    Vec3 Step(size_t frame, double share) const
    {
        return OverGround(Between(foot_.sourceAnkle[frame + 1] - foot_.sourceAnkle[frame],
                                  foot_.sourceToe[frame + 1] - foot_.sourceToe[frame], share));
    }
    /// Returns how far the source's foot has drifted since the start of a contact, one vector per frame.
    std::vector<Vec3> Drift(const Contact& contact) const;
    /// Returns the mean drift of a contact, weighted toward the frames in which the foot is slowest.
    Vec3 Middle(const Contact& contact, const std::vector<Vec3>& drift) const;

private:
    static double SquareBetween(const std::vector<float>& speeds, size_t frame)
    {
        const auto speed = static_cast<double>(speeds[frame] + speeds[frame + 1]);
        return 0.25 * speed * speed;
    }

    const FootPaths& foot_;
    std::vector<float> m_kAnkle;
    std::vector<float> m_kToe;
};

std::vector<Vec3> CPivot::Drift(const Contact& contact) const
{
    std::vector<Vec3> drift{kVec3Zero};
    for (auto frame = static_cast<size_t>(contact.first); frame + 1 < static_cast<size_t>(contact.end);
         ++frame)
        drift.push_back(drift.back() + Step(frame, Share(frame, kStillSpeed)));
    return drift;
}

Vec3 CPivot::Middle(const Contact& contact, const std::vector<Vec3>& drift) const
{
    Vec3 sum = kVec3Zero;
    double total = 0.0;
    for (size_t i = 0; i < drift.size(); ++i)
    {
        const size_t frame = static_cast<size_t>(contact.first) + i;
        const auto speed = static_cast<double>(std::min(m_kAnkle[frame], m_kToe[frame]));
        const double weight = 1.0 / (kDriftSpeed * kDriftSpeed + speed * speed);
        sum = sum + drift[i] * static_cast<float>(weight);
        total += weight;
    }
    return sum * static_cast<float>(1.0 / total);
}

// Returns the part of a drift that is kept: little of a short one, nearly all of a long one, with a smooth
// transition.
Vec3 KeptOf(const Vec3& drift, double play)
{
    const double square = Vec3Dot(drift, drift);
    return drift * static_cast<float>(square / (square + play * play));
}

// Returns the part of a drift's step that is removed; almost nothing if the step is fast.
Vec3 Lost(const Vec3& from, const Vec3& to, double leg, double secondsPerFrame)
{
    const double play = kDriftShare * leg;
    const double speed = Vec3Length(to - from) / (secondsPerFrame * leg * kDriftSpeed);
    return (to - from - (KeptOf(to, play) - KeptOf(from, play))) *
           static_cast<float>(1.0 / (1.0 + speed * speed));
}

// Returns the part of the source's drift that is removed, as a step per frame.
std::vector<Vec3> LostSteps(const CPivot& pivot, const FootPaths& foot, std::span<const Contact> contacts,
                            double secondsPerFrame)
{
    std::vector<Vec3> steps(foot.toe.size(), kVec3Zero);
    for (const Contact& contact : contacts)
    {
        const std::vector<Vec3> drift = pivot.Drift(contact);
        const Vec3 middle = pivot.Middle(contact, drift);
        for (size_t i = 0; i + 1 < drift.size(); ++i)
            steps[static_cast<size_t>(contact.first) + i] =
                Lost(drift[i] - middle, drift[i + 1] - middle, foot.leg, secondsPerFrame);
    }
    return steps;
}

// Returns the largest horizontal distance from where a stand starts, for each stand.
std::vector<double> SlidesOf(std::span<const Vec3> path, std::span<const Contact> stands)
{
    std::vector<double> slides;
    for (const Contact& stand : stands)
    {
        const Vec3& first = path[static_cast<size_t>(stand.first)];
        double square = 0.0;
        for (auto frame = static_cast<size_t>(stand.first); frame < static_cast<size_t>(stand.end); ++frame)
        {
            const Vec3 way = OverGround(path[frame] - first);
            square = std::max(square, Vec3Dot(way, way));
        }
        slides.push_back(std::sqrt(square));
    }
    return slides;
}

// Adds weight to a joint, as a logarithm, in the stands in which it slides.
void AddWeights(std::span<const Contact> stands, std::span<const double> slides, double leg, double gain,
                std::vector<float>& weights)
{
    for (size_t i = 0; i < stands.size(); ++i)
    {
        const auto more =
            static_cast<float>(gain * std::log1p(std::max(slides[i], 0.0) / (kUnseenSlide * leg)));
        for (auto frame = static_cast<size_t>(stands[i].first); frame < static_cast<size_t>(stands[i].end);
             ++frame)
            weights[frame] += more;
    }
}

std::vector<double> Differences(std::vector<double> from, std::span<const double> less)
{
    std::ranges::transform(from, less, from.begin(), std::minus<>());
    return from;
}

// A foot that stands as the source's does.
class CStandingFoot
{
public:
    CStandingFoot(const FootPaths& foot, const FootStands& stands, double secondsPerFrame)
        : foot_(foot), stands_(stands), m_kPivot(foot, secondsPerFrame, stands.jumps),
          m_kLost(LostSteps(m_kPivot, foot, stands.contacts, secondsPerFrame)),
          m_kAnkleSlides(SlidesOf(foot.sourceAnkle, stands.ankle)),
          m_kToeSlides(SlidesOf(foot.sourceToe, stands.toe)), m_kAnkle(foot.toe.size(), kVec3Zero),
          m_kToe(foot.toe.begin(), foot.toe.end())
    {
    }
    /// Returns how the foot moves. `favor` is the logarithm of wt / wa in each frame.
    StandingFoot Moved(const std::vector<float>& favor)
    {
        StandingFoot standing{std::vector<Vec3>(foot_.toe.size(), kVec3Zero), {}, {}};
        for (const Contact& contact : stands_.contacts)
        {
            for (auto frame = static_cast<size_t>(contact.first);
                 frame + 1 < static_cast<size_t>(contact.end); ++frame)
                standing.steps[frame] = Step(frame, std::exp(static_cast<double>(favor[frame])));
        }
        for (size_t frame = 0; frame + 1 < foot_.toe.size(); ++frame)
        {
            m_kAnkle[frame + 1] = m_kAnkle[frame] + standing.steps[frame];
            m_kToe[frame + 1] = m_kAnkle[frame + 1] + foot_.toe[frame + 1];
        }
        standing.ankleSlides = Differences(SlidesOf(m_kAnkle, stands_.ankle), m_kAnkleSlides);
        standing.toeSlides = Differences(SlidesOf(m_kToe, stands_.toe), m_kToeSlides);
        return standing;
    }

private:
    Vec3 Step(size_t frame, double favor) const
    {
        const double share = m_kPivot.Share(frame, kStandSpeed, favor);
        const Vec3 rolled = (foot_.toe[frame + 1] - foot_.toe[frame]) * static_cast<float>(share);
        return OverGround(m_kPivot.Step(frame, share) - m_kLost[frame] - rolled);
    }

    const FootPaths& foot_;
    const FootStands& stands_;
    CPivot m_kPivot;
    std::vector<Vec3> m_kLost;
    std::vector<double> m_kAnkleSlides; // of the source
    std::vector<double> m_kToeSlides;   // of the source
    std::vector<Vec3> m_kAnkle;         // from its place in the first frame, which is at the origin
    std::vector<Vec3> m_kToe;
};

} // namespace

StandingFoot StandSteps(const FootPaths& foot, const FootStands& stands, double secondsPerFrame)
{
    const auto slides = [](double added) { return added > 0.0; };
    CStandingFoot standing(foot, stands, secondsPerFrame);
    std::vector<float> favor(foot.toe.size(), 0.0f);
    StandingFoot moved = standing.Moved(favor);
    for (int round = 0; round < kWeightRounds && (std::ranges::any_of(moved.ankleSlides, slides) ||
                                                  std::ranges::any_of(moved.toeSlides, slides));
         ++round)
    {
        AddWeights(stands.ankle, moved.ankleSlides, foot.leg, -kWeightGain, favor);
        AddWeights(stands.toe, moved.toeSlides, foot.leg, kWeightGain, favor);
        std::vector<float> smooth = favor;
        SmoothCurve(smooth, kSpeedBlend / secondsPerFrame);
        moved = standing.Moved(smooth);
    }
    return moved;
}

} // namespace gw
