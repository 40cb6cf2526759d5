#pragma once

#include "CFileRun.h"

namespace gw {

/// Lists the conversions of a command line with many files: all files that the open dialog would show, each
/// to a Kinetra file below the output folder, or next to its source without one. Prints an error and returns
/// its code if they cannot be listed, two would write the same file, or there are none.
EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs);

} // namespace gw
