#pragma once

#include "Notice.h"

#include <string>
#include <string_view>

namespace gw {

class CFailureRecord;
struct ShellOptions;

/// Prints a line to standard error, after the program's name. Names from files must already be printable.
void SayError(std::string_view words);
/// Prints a line that is not an error of its own.
void SayPlain(std::string_view words);
/// Prints a warning; prints nothing with --quiet.
void SayWarning(const ShellOptions& options, std::string_view words);
/// Prints an error about a file. `code` is fixed and for programs: "no-folder".
void SayError(const std::string& path, const char* code, const std::string& words);
/// Returns the first error that this process has printed; its words are empty before that.
const Notice& FirstError();
/// Prints what is wrong with a command line. Always returns false, so that a check can return the result.
bool Refuse(std::string_view words);
/// Same for another error that is not about a file.
bool Refuse(const char* code, const std::string& words);
/// Same for information that is not a failure; prints nothing with --quiet.
void SayWord(const ShellOptions& options, std::string_view words);
/// Prints a failure. A warning is printed only without --quiet.
void SayNotice(const ShellOptions& options, const Notice& notice);
/// Prints the failure recorded by a file's reader or writer.
void SayFailure(const std::string& path, const Finding& failure);
/// Prints that a file cannot be written, with the system's reason.
void SayNotWritten(const std::string& path);
/// Prints all recorded warnings.
void SayWarnings(const ShellOptions& options, const std::string& path, const CFailureRecord& record);

/// Prints what stopped the reading of a container: "scene.orn: damaged at byte 381: ...".
void SayDamage(const std::string& path, const Finding& failure);

} // namespace gw
