#pragma once

namespace gw {

/// How many frames a result has for one of its source. It is 120 / rate, with rate the roundest whole rate of
/// a profile that gives the result's frame count: a count is cut to an integer, so that the quotient of the
/// counts lets the end of a motion drift by up to a frame. That quotient where no rate fits.
double FrameScaleOf(int sourceFrames, int resultFrames);

/// The number of the source's frames, from the first on, that a result of this scale has a pose for: a cut
/// count may leave out the last ones. Both counts are above 0.
int ComparedFrames(int sourceFrames, int resultFrames, double frameScale);

} // namespace gw
