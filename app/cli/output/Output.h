#pragma once

#include "CReport.h"
#include "ShellOptions.h"

#include <optional>
#include <string>

namespace gw {

/// Whether a command line does not ask for both --force and --skip-existing. Says that they exclude each
/// other.
bool IsDecidedOnExisting(const ShellOptions& options);
/// Whether there is something at a path already, a dangling link included.
bool IsTaken(const std::string& path);
/// The failure of a folder whose files cannot be listed.
CReport UnreadableFolder(const std::string& path);
/// Whether the files of a folder can be listed. Says so if not.
bool CanListFolder(const ShellOptions& options, const std::string& path);
/// Whether two paths lead to one existing file.
bool IsSameFile(const std::string& a, const std::string& b);
/// Why a command may not write a file: it is there without --force, or it is a folder. Without --force,
/// saving to a path that may be written also fails if a file appears there first.
std::optional<CReport> WhyNotWrite(const ShellOptions& options, const std::string& path);
/// Whether a command may write a file. Says why not.
bool MayWrite(const ShellOptions& options, const std::string& path);
/// Tells on standard output what was made of what. Answers Done.
EExit TellWritten(const ShellOptions& options, const std::string& source, const std::string& output);

} // namespace gw
