#pragma once

namespace gw {

/// Returns the number of result frames per source frame. It is 120 / rate, where rate is the roundest whole
/// profile rate that yields the result's frame count. The quotient of the counts would be inexact, because
/// counts are truncated, and let the end of a motion drift by up to a frame; it is used only if no rate fits.
double FrameScaleOf(int sourceFrames, int resultFrames);

/// Returns the number of source frames, starting at the first, for which a result with this scale has a pose:
/// if a count was truncated, the last ones can be missing. Both counts must be positive.
int ComparedFrames(int sourceFrames, int resultFrames, double frameScale);

} // namespace gw
