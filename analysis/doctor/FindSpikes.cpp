// A marker that is mistaken for another one throws a joint out of its motion for a frame or two, then the
// joint returns to where it would have been. No body moves like that: even a fast one that reverses is on its
// way before and after. So three conditions must hold: the step out and the step back are large, the steps
// around them are small compared to both, and the frames on both sides match: their distance is small, or
// what the surrounding motion covers in that time.

#include "FindSpikes.h"

#include "Angles.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kLongestSpike = 2;
constexpr size_t kWindow = 4;        // steps on each side that show the surrounding motion
constexpr size_t kLeastAround = 3;   // at least this many are needed for a verdict
constexpr double kMostAcross = 0.25; // distance from before to after, as a share of the jump
constexpr double kMostHaste = 1.5;   // or relative to the surrounding steps
constexpr double kMostAround = 0.2;  // the largest surrounding step, as a share of the jump

double StepBetween(const Quat& a, const Quat& b)
{
    const double dot = static_cast<double>(a.w) * b.w + static_cast<double>(a.x) * b.x +
                       static_cast<double>(a.y) * b.y + static_cast<double>(a.z) * b.z;
    return 2.0 * std::acos(std::min(std::fabs(dot), 1.0));
}

double StepBetween(const Vec3& a, const Vec3& b)
{
    return Vec3Length(a - b);
}

template <class Key>
class CSpikeSearch
{
public:
    CSpikeSearch(std::span<const Key> keys, double least) : m_kKeys(keys), m_fLeast(least)
    {
        m_kSteps.reserve(keys.size());
        for (size_t i = 0; i + 1 < keys.size(); ++i)
            m_kSteps.push_back(static_cast<float>(StepBetween(keys[i], keys[i + 1])));
    }

    std::vector<Spike> Run() const
    {
        std::vector<Spike> spikes;
        for (size_t first = 1; first + 1 < m_kKeys.size(); ++first)
        {
            const size_t count = LengthOfSpike(first);
            if (count == 0)
                continue;
            spikes.push_back({first, count});
            first += count;
        }
        return spikes;
    }

private:
    size_t LengthOfSpike(size_t first) const
    {
        if (!(m_kSteps[first - 1] >= m_fLeast))
            return 0;
        for (size_t count = 1; count <= kLongestSpike && first + count < m_kKeys.size(); ++count)
        {
            if (IsSpike(first, count))
                return count;
        }
        return 0;
    }
    bool IsSpike(size_t first, size_t count) const
    {
        const size_t behind = first + count;
        const double jump = static_cast<double>(std::min(m_kSteps[first - 1], m_kSteps[behind - 1]));
        const double around = LargestStepAround(first - 1, behind - 1);
        if (jump < m_fLeast || around < 0.0 || around > kMostAround * jump)
            return false;
        const double across = StepBetween(m_kKeys[first - 1], m_kKeys[behind]);
        return across <= std::max(kMostAcross * jump, kMostHaste * around * static_cast<double>(count + 1));
    }
    // Considers the steps before the step out and after the step back; negative if there are too few for a
    // verdict.
    double LargestStepAround(size_t out, size_t back) const
    {
        const size_t begin = out - std::min(out, kWindow);
        const size_t end = std::min(back + 1 + kWindow, m_kSteps.size());
        if ((out - begin) + (end - back - 1) < kLeastAround)
            return -1.0;
        float largest = 0.0f;
        for (size_t step = begin; step < end; ++step)
            largest = step >= out && step <= back ? largest : std::max(largest, m_kSteps[step]);
        return static_cast<double>(largest);
    }

    std::span<const Key> m_kKeys;
    double m_fLeast;
    std::vector<float> m_kSteps; // distance from each frame to the next
};

} // namespace

std::vector<Spike> FindSpikes(std::span<const Quat> rotations)
{
    return CSpikeSearch(rotations, kLeastSpikeDegrees * kDegreesToRadians64).Run();
}

std::vector<Spike> FindSpikes(std::span<const Vec3> positions, double least)
{
    return CSpikeSearch(positions, least).Run();
}

} // namespace gw
