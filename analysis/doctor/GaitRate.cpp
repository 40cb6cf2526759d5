// A wrong frame rate cannot be seen in a pose, only in time, and time is what is in doubt. Steps reveal it:
// from a slow walk to a run, the ratio of step length to step frequency is about constant (the "walk ratio",
// 0.0065 m per step per minute for adults). So the step length, which needs no clock, predicts the steps per
// minute, and comparing that with the frames per step gives the rate.
//
// Steps are found without a clock, a heading or a floor: the distance between the feet over the ground has
// one maximum per step.

#include "GaitRate.h"

#include "BodyPaths.h"

#include <algorithm>
#include <cmath>
#include <span>
#include <vector>

namespace gw {

namespace {

constexpr double kWalkRatio = 0.0065; // meters, for a step per minute
constexpr double kLegMetres = 0.82;   // thigh plus shin of an adult
constexpr double kSlowest = 70.0;     // steps per minute: a stroll
constexpr double kFastest = 220.0;    // a sprint
constexpr double kMostApart = 2.0;    // rates that differ by this factor are different rates

constexpr size_t kLeastSteps = 4;
constexpr double kLeastSpread =
    // of the leg: how much further apart the feet are in a step than side by side
    0.3;
constexpr double kLeastStep = 0.35;     // of the leg: shorter steps are a dance or a turn
constexpr double kMostStep = 2.2;       // longer steps are jumps
constexpr double kMostVariation = 0.25; // standard deviation by mean, of durations and lengths
// the standing foot moves at most this share of the other foot's movement
constexpr double kStandingShare = 0.4;
constexpr double kLeastStandShare = 0.75; // of the steps in which one foot stands

// Mean, and standard deviation relative to it.
struct Spread
{
    explicit Spread(std::span<const double> values)
    {
        const auto count = static_cast<double>(values.size());
        for (const double value : values)
            mean += value / count;
        double square = 0.0;
        for (const double value : values)
            square += (value - mean) * (value - mean) / count;
        variation = mean > 0.0 ? std::sqrt(square) / mean : 0.0;
    }

    double mean = 0.0;
    double variation = 0.0;
};

class CStepSearch
{
public:
    CStepSearch(const BodyPaths& paths, const Vec3& up, double leg) : paths_(paths), m_kUp(up), m_fLeg(leg)
    {
        for (size_t frame = 0; frame < paths.FrameCount(); ++frame)
            m_kApart.push_back(GroundDistance(paths.feet[0][frame], paths.feet[1][frame]));
    }

    std::optional<Gait> Run()
    {
        FindSteps();
        if (m_kSteps.size() < kLeastSteps + 1 || !FeetTakeTurns())
            return std::nullopt;
        std::vector<double> frames;
        std::vector<double> lengths;
        for (size_t i = 1; i < m_kSteps.size(); ++i)
        {
            frames.push_back(static_cast<double>(m_kSteps[i] - m_kSteps[i - 1]));
            lengths.push_back(GroundDistance(paths_.hip[m_kSteps[i - 1]], paths_.hip[m_kSteps[i]]) / m_fLeg);
        }
        const Spread time(frames);
        const Spread length(lengths);
        const bool regular = time.variation <= kMostVariation && length.variation <= kMostVariation;
        if (!regular || length.mean < kLeastStep || length.mean > kMostStep)
            return std::nullopt;
        return Gait{time.mean, length.mean};
    }

private:
    double GroundDistance(const Vec3& a, const Vec3& b) const
    {
        const Vec3 d = a - b;
        const double height = Vec3Dot(d, m_kUp);
        return std::sqrt(std::max(Vec3Dot(d, d) - height * height, 0.0));
    }
    double Share(double share) const
    {
        std::vector<double> sorted = m_kApart;
        const auto nth =
            sorted.begin() + static_cast<std::ptrdiff_t>(share * static_cast<double>(sorted.size() - 1));
        std::ranges::nth_element(sorted, nth);
        return *nth;
    }
    // A step is where the feet move apart: above the upper line after having been below the lower one.
    void FindSteps()
    {
        if (m_kApart.empty())
            return;
        const double low = Share(0.1);
        const double high = Share(0.9);
        if (high - low < kLeastSpread * m_fLeg)
            return;
        bool armed = false;
        for (size_t frame = 0; frame < m_kApart.size(); ++frame)
        {
            armed = armed || m_kApart[frame] < low + 0.4 * (high - low);
            if (!armed || m_kApart[frame] < low + 0.6 * (high - low))
                continue;
            m_kSteps.push_back(frame);
            armed = false;
        }
    }
    // While the feet pass each other, half a step before they are furthest apart, one of them stands still.
    bool FeetTakeTurns() const
    {
        size_t stands = 0;
        for (size_t i = 1; i < m_kSteps.size(); ++i)
            stands += OneFootStands(m_kSteps[i - 1], m_kSteps[i]);
        return static_cast<double>(stands) >= kLeastStandShare * static_cast<double>(m_kSteps.size() - 1);
    }
    bool OneFootStands(size_t begin, size_t end) const
    {
        const auto first = m_kApart.begin() + static_cast<std::ptrdiff_t>(begin);
        const auto last = m_kApart.begin() + static_cast<std::ptrdiff_t>(end);
        const auto passing = static_cast<size_t>(std::min_element(first, last) - m_kApart.begin());
        const size_t around = std::max<size_t>((end - begin) / 8, 1);
        const size_t from = passing - std::min(passing, around);
        const size_t to = std::min(passing + around, m_kApart.size() - 1);
        const double left = GroundDistance(paths_.feet[0][from], paths_.feet[0][to]);
        const double right = GroundDistance(paths_.feet[1][from], paths_.feet[1][to]);
        return std::min(left, right) <= kStandingShare * std::max(left, right);
    }

    const BodyPaths& paths_;
    Vec3 m_kUp;
    double m_fLeg;
    std::vector<double> m_kApart; // distance between the feet over the ground
    std::vector<size_t> m_kSteps; // frames in which they move apart
};

} // namespace

double Gait::UsualRate() const
{
    const double stepsPerMinute = std::clamp(stepLength * kLegMetres / kWalkRatio, kSlowest, kFastest);
    return framesPerStep * stepsPerMinute / 60.0;
}

std::optional<Gait> FindGait(const BodyPaths& paths, const Vec3& up, double leg)
{
    if (!(leg > 0.0))
        return std::nullopt;
    return CStepSearch(paths, up, leg).Run();
}

bool IsOtherRate(const Gait& gait, double rate)
{
    const double factor = gait.UsualRate() / rate;
    return factor >= kMostApart || factor <= 1.0 / kMostApart;
}

} // namespace gw
