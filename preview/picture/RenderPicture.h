#pragma once

#include "CNode.h"
#include "RgbPicture.h"

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// A motion to be shown: its tree and its timing.
struct PictureMotion
{
    Ref<CNode> root; ///< null shows nothing
    float frameStep = 0.0f;
    float lastFrame = 0.0f;
};

/// The content of a picture. A single pose shows the motions side by side; several poses form a row per
/// motion, from the frame to the end of the motion. All motions are at the same fraction of their length, as
/// under the window's scroll bar.
struct PictureOptions
{
    std::vector<PictureMotion> motions; ///< source, result
    int width = 640;
    int height = 480;
    int frame = 0; ///< of the first motion; clamped to its range
    int poseCount = 1;
    std::string highlight; ///< bone in another color, or empty
};

enum class EPictureAnswer : uint8_t
{
    Done,
    BadSize,   ///< no motion or pose, more than there are pixels, or a side below 1 or above kLongestSide
    NoContext, ///< the machine's GL cannot draw without a display
    NoPainter, ///< the drawing module, or a library that it needs, is missing
};

inline constexpr int kLongestSide = 8192; ///< 200 MB of pixels; software renderers support no more

/// Returns whether the numbers of motions and poses and the size are valid for RenderPicture; checks nothing
/// else.
bool IsDrawable(const PictureOptions& options);

/// Returns the first frame of a picture, clamped to the motion's range. There must be a motion.
int FirstFrame(const PictureOptions& options);

/// Draws without a display. Each pose is centered in its view and as large as possible; all poses of a motion
/// have the same scale. Leaves the motions evaluated at the last pose. Unless it returns Done, `picture` is
/// unchanged.
EPictureAnswer RenderPicture(const PictureOptions& options, RgbPicture& picture);

} // namespace gw
