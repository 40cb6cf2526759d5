#include "Series.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <deque>
#include <functional>

namespace gw {

namespace {

constexpr double kMostFrames = 1e6; // some files have frames of zero length

} // namespace

int FramesIn(double seconds, double secondsPerFrame)
{
    return std::max(1, static_cast<int>(std::lround(std::min(seconds / secondsPerFrame, kMostFrames))));
}

// The queue holds the values that can still become the largest: each is followed only by smaller ones.
std::vector<float> SlidingLargest(std::span<const float> values, int before, int after)
{
    const auto count = static_cast<std::ptrdiff_t>(values.size());
    std::vector<float> largest(values.size());
    std::deque<std::ptrdiff_t> queue;
    const auto at = [values](std::ptrdiff_t i) { return values[static_cast<size_t>(i)]; };
    std::ptrdiff_t next = 0;
    for (std::ptrdiff_t i = 0; i < count; ++i)
    {
        for (; next < count && next <= i + after; ++next)
        {
            while (!queue.empty() && !(at(queue.back()) > at(next)))
                queue.pop_back();
            queue.push_back(next);
        }
        while (queue.front() < i - before)
            queue.pop_front();
        largest[static_cast<size_t>(i)] = at(queue.front());
    }
    return largest;
}

std::vector<float> LargestChanges(std::span<const float> values, int before)
{
    std::vector<float> changes = SlidingLargest(values, before, 0);
    std::vector<float> negative(values.size());
    std::ranges::transform(values, negative.begin(), std::negate());
    const std::vector<float> lowest = SlidingLargest(negative, before, 0);
    for (size_t i = 0; i < values.size(); ++i)
        changes[i] = std::max(changes[i] - values[i], values[i] + lowest[i]);
    return changes;
}

double Median(std::vector<float> values)
{
    std::erase_if(values, [](float value) { return !std::isfinite(value); });
    if (values.empty())
        return 0.0;
    const auto upper = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), upper, values.end());
    const auto middle = static_cast<double>(*upper);
    if (values.size() % 2 == 1)
        return middle;
    return 0.5 * (middle + static_cast<double>(*std::max_element(values.begin(), upper)));
}

} // namespace gw
