#pragma once

#include "CFileRun.h"

namespace gw {

/// The conversions that a command line of many files asks for: of all that the open dialog would show, each
/// to a Kinetra file below the output folder, or beside its source where there is none. Anything but Done,
/// and says why, where they cannot be listed, two would write one file, or there are none.
EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs);

} // namespace gw
