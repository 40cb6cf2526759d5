#pragma once

#include "CNode.h"
#include "RgbPicture.h"

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// A motion to be shown: its tree, and its timing as for a view.
struct PictureMotion
{
    Ref<CNode> root; ///< null shows nothing
    float frameStep = 0.0f;
    float lastFrame = 0.0f;
};

/// What a picture shows. One pose shows the motions side by side; several poses stand in a row, from the
/// frame on to the end of the motion, with a row for each motion. All motions stand at the same share of
/// their length, as under the scroll bar of the window.
struct PictureOptions
{
    std::vector<PictureMotion> motions; ///< source, result
    int width = 640;
    int height = 480;
    int frame = 0; ///< of the first motion; outside of it the nearest one that there is
    int poseCount = 1;
    std::string highlight; ///< bone in another colour, empty for none
};

enum class EPictureAnswer : uint8_t
{
    Done,
    BadSize,   ///< no motion or no pose, more than there are pixels, or a side below 1 or above kLongestSide
    NoContext, ///< the machine's GL draws nothing without a display
    NoPainter, ///< the module that draws, or a library that it needs, is not there
};

inline constexpr int kLongestSide = 8192; ///< 200 MB of pixels; software renderers take no more

/// Whether the number of motions and poses and the size are such that RenderPicture draws; it looks at
/// nothing else.
bool IsDrawable(const PictureOptions& options);

/// The frame that a picture begins with: the one asked for, or the nearest one that there is. There must be a
/// motion.
int FirstFrame(const PictureOptions& options);

/// Draws without any display. Each pose is in the middle of its view and as large as all of it can be seen,
/// the poses of a motion at one scale. The motions stand evaluated at the last pose
/// afterwards. Without Done the picture is left as it was.
EPictureAnswer RenderPicture(const PictureOptions& options, RgbPicture& picture);

} // namespace gw
