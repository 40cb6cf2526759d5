#pragma once

#include "RgbPicture.h"

#include <string>

namespace gw {

/// Writes a picture or replaces one, in one step. False for a picture without pixels and for a file that
/// cannot be written; an old file stands then.
bool WritePng(const std::string& path, const RgbPicture& picture);

} // namespace gw
