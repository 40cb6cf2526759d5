#pragma once

#include <string>
#include <string_view>

namespace gw {

class CFailureRecord;
struct CFailure;
struct ShellOptions;
struct CReport;

/// A line on standard error under the program's name. Names from files must be printable already.
void SayError(std::string_view words);
/// The same for a command line that cannot be carried out; false, for its check to return.
bool Refuse(std::string_view words);
/// The same for what is good to know and no failure; silent with --quiet.
void SayWord(const ShellOptions& options, std::string_view words);
/// A failure always, a warning unless --quiet.
void SayReport(const ShellOptions& options, const CReport& report);
/// A failure that only the shell knows of. The code is a short fixed word for programs.
CReport ShellFailure(const std::string& path, const char* code, const std::string& words);
/// The failure that a file's reader or writer kept, in words.
void SayFailure(const std::string& path, const CFailure& failure);
/// All warnings that it kept.
void SayWarnings(const ShellOptions& options, const std::string& path, const CFailureRecord& record);

/// What stopped the reading of a container: "scene.orn: damaged at byte 381: ...".
void SayDamage(const std::string& path, const CFailure& failure);

} // namespace gw
