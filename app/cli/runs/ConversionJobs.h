#pragma once

#include "CFileRun.h"

namespace gw {

/// Lists the conversions of a command line with many files: all motion files in the folders, each
/// converted to a Kinetra file below the output folder, or next to its source if there is none. If they
/// cannot be listed, if two would write the same file, or if there are none, prints an error and returns its
/// code.
EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs);

} // namespace gw
