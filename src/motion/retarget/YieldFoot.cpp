// A foot that rotates like the source's but is longer moves its toe farther relative to its ankle. While both
// joints stand, in a turn on the spot or when the heel comes up, at least one of them must slide, however the
// foot is placed. Nobody sees that a foot turns by 90 degrees instead of 95, but a slide of two centimeters
// is seen. So the foot gives way by a few degrees.
//
// Let c be how much farther the toe moves relative to the ankle, from one frame to the next, than it does in
// the source. As much of c is taken away as is needed to keep both joints from sliding farther than the
// source's: the foot's toe is displaced by a curve whose steps are that share of -c wherever both joints
// stand. The curve is found by least squares over all frames, so it is small and smooth, and builds up and
// goes away in the swing. Its parts along the foot and across it are separate curves. The first one is a
// pitch, which lifts the sole of a flat foot off the floor and moves its toe hardly at all, so it is kept
// small while the foot is flat. The second one is a turn about y.

#include "YieldFoot.h"

#include "CBandFit.h"
#include "Directions.h"
#include "Figures.h"
#include "FootPitch.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kMostTurn = 0.15;     // radians; more would look like another foot
constexpr double kMargin = 0.003;      // in leg lengths; joints should slide this much less than the source's
constexpr double kTurnHertz = 2.5;     // of the changes of the turn
constexpr double kTurnSeconds = 4.0;   // how long a foot keeps its turn if it stands
constexpr double kLifted = 15.0;       // millimeters between ankle and toe of a foot that is clearly not flat
constexpr double kFlatYield = 0.02;    // readiness of a flat foot to pitch; a lifted one has 1
constexpr double kUsualHeight = 100.0; // millimeters between ankle and toe of a lifted foot
constexpr double kLeastArm = 20.0; // millimeters; over a shorter distance, a turn moves the toe too little
constexpr double kNothing = 0.005; // millimeters that are not worth a rotation
constexpr double kUpright = 0.5;   // a foot whose horizontal part is a smaller share of it yields less

struct Axes
{
    Vec3 ahead; // horizontal unit vectors; zero for a vertical foot
    Vec3 aside;
};

Axes AxesOf(const Vec3& toe)
{
    const Vec3 ahead = Vec3Normalized(OverGround(toe));
    return {
        ahead, {ahead.z, 0.0f, -ahead.x}
    };
}

// Frames in which both joints stand, and how far each slides.
struct BothStand
{
    size_t first;
    size_t end;
    double ankleSlide;
    double toeSlide;
};

std::vector<BothStand> BothOf(const FootStands& stands, const StandingFoot& foot)
{
    std::vector<BothStand> both;
    for (size_t a = 0, t = 0; a < stands.ankle.size() && t < stands.toe.size();)
    {
        const Contact& ankle = stands.ankle[a];
        const Contact& toe = stands.toe[t];
        const int first = std::max(ankle.first, toe.first);
        const int end = std::min(ankle.end, toe.end);
        if (first < end)
            both.push_back({static_cast<size_t>(first), static_cast<size_t>(end), foot.ankleSlides[a],
                            foot.toeSlides[t]});
        ankle.end < toe.end ? ++a : ++t;
    }
    return both;
}

// Returns how much farther the target's toe moves relative to its ankle than the source's.
Vec3 ConflictBetween(const FootPaths& foot, size_t from, size_t to)
{
    const auto source = [&](size_t frame) { return foot.sourceToe[frame] - foot.sourceAnkle[frame]; };
    return OverGround((foot.toe[to] - foot.toe[from]) - (source(to) - source(from)));
}

// Returns the share of a conflict that must be taken away.
double ShareToTake(const FootPaths& foot, const BothStand& both)
{
    double square = 0.0;
    for (size_t frame = both.first; frame < both.end; ++frame)
    {
        const Vec3 conflict = ConflictBetween(foot, both.first, frame);
        square = std::max(square, Vec3Dot(conflict, conflict));
    }
    const double span = std::sqrt(square);
    const double margin = kMargin * foot.leg;
    const double excess = std::max(both.ankleSlide + margin, 0.0) + std::max(both.toeSlide + margin, 0.0);
    return excess < span ? excess / span : 1.0;
}

// Returns the rotation that moves a toe ahead and aside, up to a soft limit.
Mat3 TurnOf(const Vec3& toe, double ahead, double aside)
{
    const ToePlace place = ToePlaceOf(toe);
    const double length = std::hypot(place.ahead, place.height);
    const double most = kMostTurn * Smoothstep(place.ahead / (length * kUpright));
    const auto turn = [&](double way, double arm) {
        return most * std::tanh(way / std::max(arm, kLeastArm) / kMostTurn);
    };
    const double up = std::atan2(place.height, place.ahead) + turn(ahead, -place.height);
    const double yaw = turn(aside, place.ahead);
    const Axes axes = AxesOf(toe);
    if (axes.ahead == kVec3Zero || !std::isfinite(up) || !std::isfinite(yaw))
        return kMat3Identity;
    Vec3 pitched = axes.ahead * static_cast<float>(length * std::cos(up));
    pitched.y = static_cast<float>(length * std::sin(up));
    const Vec3 heading =
        axes.ahead * static_cast<float>(std::cos(yaw)) + axes.aside * static_cast<float>(std::sin(yaw));
    return LeastSwing(toe, pitched) * LeastSwing(axes.ahead, heading);
}

} // namespace

std::vector<Mat3> YieldFoot(const FootPaths& foot, const FootStands& stands, std::span<const float> lifts,
                            double secondsPerFrame)
{
    const size_t count = foot.toe.size();
    const double stepWeight = std::pow(kTurnSeconds / secondsPerFrame, 2.0);
    CBandFit ahead(count, BendWeight(kTurnHertz, secondsPerFrame), 0.0);
    CBandFit aside(count, BendWeight(kTurnHertz, secondsPerFrame), 1.0);
    for (size_t frame = 0; frame < count; ++frame)
    {
        const double height = std::max(static_cast<double>(-foot.toe[frame].y), kLeastArm);
        const double yield = kFlatYield + Smoothstep(static_cast<double>(lifts[frame]) / kLifted);
        ahead.AddValue(frame, std::pow(kUsualHeight / height, 2.0) / yield, 0.0);
    }
    for (const BothStand& both : BothOf(stands, StandSteps(foot, stands, secondsPerFrame)))
    {
        const double share = ShareToTake(foot, both);
        for (size_t frame = both.first; share > 0.0 && frame + 1 < both.end; ++frame)
        {
            const Axes axes = AxesOf(foot.toe[frame] + foot.toe[frame + 1]);
            const Vec3 taken = ConflictBetween(foot, frame, frame + 1) * static_cast<float>(-share);
            ahead.AddStep(frame, stepWeight, static_cast<double>(Vec3Dot(taken, axes.ahead)));
            aside.AddStep(frame, stepWeight, static_cast<double>(Vec3Dot(taken, axes.aside)));
        }
    }
    const std::vector<double> aheadBy = ahead.Solve();
    const std::vector<double> asideBy = aside.Solve();
    std::vector<Mat3> turns;
    for (size_t frame = 0; frame < count; ++frame)
        turns.push_back(std::fabs(aheadBy[frame]) + std::fabs(asideBy[frame]) < kNothing
                            ? kMat3Identity
                            : TurnOf(foot.toe[frame], aheadBy[frame], asideBy[frame]));
    return turns;
}

} // namespace gw
