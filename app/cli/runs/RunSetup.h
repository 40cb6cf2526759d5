#pragma once

#include "CFileRun.h"

namespace gw {

/// Whether the options of a run over many files go together. Says why not.
bool IsRunPossible(const ShellOptions& options);
/// Whether no two jobs write the same file. Says which do.
bool AreOutputsApart(const CFileRun::Jobs& jobs);
/// Makes the output folder, if there is to be one. Says why it cannot.
bool MakeOutputFolder(const ShellOptions& options);
/// Where --resume keeps what was done: in the output folder, else in the folder of the sources.
RunState StateOf(const ShellOptions& options);

} // namespace gw
