#pragma once

#include <span>
#include <vector>

namespace gw {

/// Of figures by frames, the share below which none is an outlier: what is reported is this percentile.
inline constexpr double kMostShare = 0.95;

/// The number of frames nearest to a time, at least 1.
int FramesIn(double seconds, double secondsPerFrame);

/// For each value the largest one from `before` places ahead of it to `after` places behind it. Takes time in
/// proportion to the number of values, whatever the window.
std::vector<float> SlidingLargest(std::span<const float> values, int before, int after);

/// For each value the largest difference from one of the `before` values ahead of it, 0 and above.
std::vector<float> LargestChanges(std::span<const float> values, int before);

/// The middle one of the finite values, or the mean of the two in the middle; 0 without values.
double Median(std::vector<float> values);

} // namespace gw
