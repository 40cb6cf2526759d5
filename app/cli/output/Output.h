#pragma once

#include "Notice.h"
#include "ShellOptions.h"

#include <optional>
#include <string>

namespace gw {

/// Returns whether a command line does not combine --force and --skip-existing, which exclude each other;
/// prints an error if it does.
bool IsDecidedOnExisting(const ShellOptions& options);
/// Returns whether anything exists at a path, including a dangling link.
bool IsTaken(const std::string& path);
/// Returns the failure for a folder whose files cannot be listed.
Notice UnreadableFolder(const std::string& path);
/// Returns why a path in a list of sources is none: a folder that could not be read, in place of its files,
/// or a link to a file that does not exist.
std::optional<Notice> WhyNoSource(const std::string& path);
/// Returns whether the files of a folder can be listed; prints an error if not.
bool CanListFolder(const ShellOptions& options, const std::string& path);
/// Returns the reason why a command must not write a file: it exists and --force is missing, or it is a
/// folder. No value if it may. Even then, saving without --force fails if the file appears in the meantime.
std::optional<Notice> WhyNotWrite(const ShellOptions& options, const std::string& path);
/// Returns whether a command may write a file; prints an error if not.
bool MayWrite(const ShellOptions& options, const std::string& path);
/// Prints a line about an output: to standard output, unless that is the output, otherwise to standard error.
void PrintResult(const ShellOptions& options, const std::string& output, const std::string& line);
/// Prints which source was written to which output. Returns Done.
EExit TellWritten(const ShellOptions& options, const std::string& source, const std::string& output);

} // namespace gw
