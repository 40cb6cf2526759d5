#pragma once

#include "CPicture.h"

#include <string>

namespace gw {

/// Reads every row of a picture in both forms, as far as it can be read. False where a row cannot.
bool ReadsWhole(CPicture& picture);
/// Requires that a copy of a picture can be written and has the same colours.
void RequireSameCopy(CPicture& picture, const std::string& path);

} // namespace gw
