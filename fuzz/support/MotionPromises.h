#pragma once

#include "CMotionFile.h"

#include <string_view>

namespace gw {

/// Requires that a motion which was read can be posed over its whole length.
void RequireSoundMotion(CMotionFile& motion);
/// Whether the bones have names that are told apart in an HTR file: no two are equal, and none is one of the
/// format's own words.
bool HasPlainNames(const CMotionFile& motion);
/// Requires that a file in the scratch folder holds a motion with the same bones in the same order. A return
/// at the end of a name becomes part of a line end.
void RequireSameBones(const CMotionFile& motion, std::string_view scratchName);

} // namespace gw
