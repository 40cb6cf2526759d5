#pragma once

#include "CMotionFile.h"

#include <string_view>

namespace gw {

/// Requires that a motion that was read can be posed over its whole length.
void RequireSoundMotion(CMotionFile& motion);
/// Returns true if the bones' names are unambiguous in an HTR file: all different, and none a keyword of the
/// format.
bool HasPlainNames(const CMotionFile& motion);
/// Requires that a file in the scratch folder contains a motion with the same bones in the same order. A
/// carriage return at the end of a name may become part of the line end.
void RequireSameBones(const CMotionFile& motion, std::string_view scratchName);

} // namespace gw
