#pragma once

#include "CFileRun.h"

namespace gw {

/// Returns whether the options of a run over many files can be combined; prints an error if not.
bool IsRunPossible(const ShellOptions& options);
/// Returns whether all jobs write different files; prints those that conflict.
bool AreOutputsApart(const CFileRun::Jobs& jobs);
/// Creates the output folder and that of the drafts, if they are given. Returns false, after printing the
/// reason, if that fails.
bool MakeOutputFolder(const ShellOptions& options);
/// Returns the location of the --resume state: the output folder, otherwise the folder of the sources.
RunState StateOf(const ShellOptions& options);
/// Returns the folder in which a --resume run keeps its drafts, by the folder of its state.
std::string ResumeDrafts(const std::string& stateFolder);

} // namespace gw
