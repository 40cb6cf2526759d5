#pragma once

#include "CPictureCamera.h"
#include "PictureMotion.h"
#include "RgbPicture.h"

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace gw {

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
    EPictureView view = EPictureView::Front;
    bool isDark = false;
    bool hasAxes = false;  ///< with the axes of every bone in red, green and blue
    bool hasLabels = true; ///< with the motions' labels and the frame numbers, if there is room
    std::string highlight; ///< bone whose meshes get another color, or empty
};

enum class EPictureAnswer : uint8_t
{
    Done,
    BadSize,   ///< no motion or pose, more than there are pixels, or a side below 1 or above kLongestSide
    NoContext, ///< the machine's GL cannot draw without a display
    NoPainter, ///< the drawing module, or a library that it needs, is missing
    Stopped,   ///< the receiver of frames returned false
};

inline constexpr int kLongestSide = 8192; ///< 200 MB of pixels; software renderers support no more

/// Returns whether the numbers of motions and poses and the size are valid for RenderPicture; checks nothing
/// else.
bool IsDrawable(const PictureOptions& options);

/// Returns the index of a motion's last frame.
int LastFrame(const PictureMotion& motion);
/// Returns the first frame of a picture, clamped to the motion's range. There must be a motion.
int FirstFrame(const PictureOptions& options);

/// Draws without a display. Each pose is centered in its view and stands on the floor; all poses of a motion
/// have the same scale, which is as large as possible. Leaves the motions evaluated at the last pose. Unless
/// it returns Done, `picture` is unchanged.
EPictureAnswer RenderPicture(const PictureOptions& options, RgbPicture& picture);

/// Draws `count` pictures of a single pose each, at every `stride`-th frame from the first one, all with the
/// same scale; passes each to `take`, which returns false to stop.
EPictureAnswer RenderFrames(const PictureOptions& options, int count, int stride,
                            const std::function<bool(const RgbPicture&)>& take);

} // namespace gw
