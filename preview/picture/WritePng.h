#pragma once

#include "RgbPicture.h"

#include <string>

namespace gw {

/// Writes a picture atomically, replacing an old one. Returns false, keeping an old file, if the picture has
/// no pixels or the file cannot be written.
bool WritePng(const std::string& path, const RgbPicture& picture);

} // namespace gw
