#pragma once

#include "CPicture.h"

#include <string>

namespace gw {

/// Reads every row of a picture in both forms, as far as possible. Returns false if a row cannot be read.
bool ReadsWhole(CPicture& picture);
/// Requires that a copy of a picture can be written and has the same colors.
void RequireSameCopy(CPicture& picture, const std::string& path);

} // namespace gw
