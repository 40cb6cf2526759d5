#pragma once

#include <string_view>
#include <vector>

namespace gw {

class CJsonWriter;
enum class EExit : int;
struct Notice;

// Every object that --json prints has a `status`: "ok", "failed", or what became of a source. After a failure
// it also has an `error` with the members reason, path, line, byte, name and words.

/// Writes the members of an open object for a piece of work that succeeded.
void WriteStatus(CJsonWriter& json, std::string_view status);
/// Same for work that failed.
void WriteFailed(CJsonWriter& json, const Notice& error);
/// Writes the status, or the first error among the notices if there is one.
void WriteStatus(CJsonWriter& json, std::string_view status, const std::vector<Notice>& notices);

/// Returns whether a command line has the option --json, even if it cannot be parsed.
bool IsJsonAsked(int argc, char** argv);
/// Ends the output of a command: unless it has already written an object with its status, writes one.
void FinishJson(std::string_view command, EExit exit);

} // namespace gw
