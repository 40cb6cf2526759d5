// A foot stands on its heel first, then flat, then on its ball while the heel comes up. If the foot has a
// different length, ankle and toe cannot both move like the source's. Let va and vt be their speeds in the
// source. Each requests its own steps with the weight 1 / (v^2 + e^2), where e is a speed at which a foot
// just stands. By least squares, the point at the fraction
//
//     u = (va^2 + e^2) / (va^2 + vt^2 + 2 e^2)
//
// of the line from ankle to toe moves like the source's. It is the joint that stands, or a point between the
// two while both stand. As the vector from ankle to toe changes, the foot rotates about this point.
//
// The source's foot may drift while it stands, because sensors drift and feet are dragged. The drift is
// measured at the point for a small e, which does not move while a foot rolls. A short drift is mostly
// removed, a long one mostly kept.
//
// So contacts determine the steps of the ankle, not its positions. The positions follow by least squares over
// all frames: match the steps of the contacts, stay close to the free path, and do not change the offset from
// it suddenly. One solution gives each contact its position and blends the swing between two contacts. If the
// source's hips shake, the feet keep that shaking: feet held still below shaking hips would make the legs
// shake instead.

#include "HoldFoot.h"

#include "Angles.h"
#include "CBandFit.h"
#include "Figures.h"
#include "SmoothCurve.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// In leg lengths per second.

constexpr double kStillSpeed = 0.12; // of a foot that certainly stands
constexpr double kDriftSpeed = 0.15; // of a foot that moves instead of drifting

constexpr double kSpeedBlend = 0.03;  // seconds over which the speeds that set the pivot are smoothed
constexpr double kDriftShare = 0.03;  // in leg lengths: half of a drift this long is kept
constexpr double kReturnHertz = 2.0;  // of the return to the free path, which then takes 0.2 s
constexpr double kHoldSeconds = 10.0; // how long a foot that is held off its free path takes to creep back
constexpr double kShakeHertz = 6.0;   // faster shaking of hips, legs and feet is left in the foot

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
    /// Returns where the pivot is between a frame and the next: 0 at the ankle, 1 at the toe. `still` is e.
    double Share(size_t frame, double still) const
    {
        return 0.5 * (ShareAt(frame, still) + ShareAt(frame + 1, still));
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
    double ShareAt(size_t frame, double still) const
    {
        const double ankle = std::pow(static_cast<double>(m_kAnkle[frame]), 2.0) + still * still;
        const double toe = std::pow(static_cast<double>(m_kToe[frame]), 2.0) + still * still;
        return ankle / (ankle + toe);
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

} // namespace

std::vector<Vec3> HoldFoot(const FootPaths& foot, std::span<const Contact> contacts, double secondsPerFrame,
                           std::span<const size_t> jumps)
{
    const CPivot pivot(foot, secondsPerFrame, jumps);
    const double bend = BendWeight(kReturnHertz, secondsPerFrame);
    const double stepWeight = std::pow(kHoldSeconds / secondsPerFrame, 2.0);
    const double shakeWeight = stepWeight * std::pow(kTwoPi64 * kShakeHertz * secondsPerFrame, -2.0);
    CBandFit x(foot.free.size(), bend, 1.0);
    CBandFit z(foot.free.size(), bend, 1.0);
    for (const Contact& contact : contacts)
    {
        const std::vector<Vec3> drift = pivot.Drift(contact);
        const Vec3 middle = pivot.Middle(contact, drift);
        for (size_t i = 0; i + 1 < drift.size(); ++i)
        {
            const size_t frame = static_cast<size_t>(contact.first) + i;
            const double share = pivot.Share(frame, kStandSpeed);
            const Vec3 rolled = (foot.toe[frame + 1] - foot.toe[frame]) * static_cast<float>(share);
            const Vec3 step = pivot.Step(frame, share) -
                              Lost(drift[i] - middle, drift[i + 1] - middle, foot.leg, secondsPerFrame) -
                              rolled - (foot.free[frame + 1] - foot.free[frame]);
            x.AddStep(frame, stepWeight, static_cast<double>(step.x));
            z.AddStep(frame, stepWeight, static_cast<double>(step.z));
            if (i + 2 < drift.size())
            {
                x.AddBend(frame, shakeWeight);
                z.AddBend(frame, shakeWeight);
            }
        }
    }
    const std::vector<double> offX = x.Solve();
    const std::vector<double> offZ = z.Solve();
    std::vector<Vec3> path(foot.free.begin(), foot.free.end());
    for (size_t frame = 0; frame < path.size(); ++frame)
        path[frame] =
            path[frame] + Vec3{static_cast<float>(offX[frame]), 0.0f, static_cast<float>(offZ[frame])};
    return path;
}

} // namespace gw
