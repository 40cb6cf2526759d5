#pragma once

#include "CFileRun.h"

namespace gw {

/// Returns whether the options of a run over many files can be combined; prints an error if not.
bool IsRunPossible(const ShellOptions& options);
/// Returns whether all jobs write different files; prints those that do not.
bool AreOutputsApart(const CFileRun::Jobs& jobs);
/// Creates the output folder, if one is given. Prints why it fails.
bool MakeOutputFolder(const ShellOptions& options);
/// Returns where --resume keeps its state: in the output folder, otherwise in the folder of the sources.
RunState StateOf(const ShellOptions& options);

} // namespace gw
