#pragma once

#include "RgbPicture.h"

#include <cstdint>
#include <string>

namespace gw {

struct PictureOptions;
enum class EPictureAnswer : uint8_t;

/// Writes a picture atomically, replacing an old one. Returns false, keeping an old file, if the picture has
/// no pixels or the file cannot be written.
bool WritePng(const std::string& path, const RgbPicture& picture);

/// An animation to be written.
struct PngAnimation
{
    int frameCount = 1;
    int stride = 1;               ///< frames of the motion per frame of the animation
    double secondsPerFrame = 0.0; ///< of the animation
};

/// Draws and writes an animation atomically, frame by frame. Returns Stopped, keeping an old file, if the
/// file cannot be written.
EPictureAnswer WriteAnimation(const std::string& path, const PictureOptions& options,
                              const PngAnimation& animation);

} // namespace gw
