#pragma once

#include <span>
#include <vector>

namespace gw {

/// The percentile that is reported as the usual maximum of a figure over frames; values above it count as
/// outliers.
inline constexpr double kMostShare = 0.95;

/// Returns the number of frames closest to a time, at least 1.
int FramesIn(double seconds, double secondsPerFrame);

/// Returns, for each value, the largest value in a window from `before` positions before it to `after`
/// positions after it. Runs in time proportional to the number of values, whatever the window.
std::vector<float> SlidingLargest(std::span<const float> values, int before, int after);

/// Returns, for each value, the largest absolute difference from one of the `before` values before it.
std::vector<float> LargestChanges(std::span<const float> values, int before);

/// Returns the median of the finite values, which is the mean of the middle two for an even count; 0 without
/// values.
double Median(std::vector<float> values);

} // namespace gw
