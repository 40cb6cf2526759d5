#pragma once

#include "ShellOptions.h"

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

namespace gw {

class CDraftShelf;
class CPagePart;
struct Notice;

/// A source and its output file.
struct ConversionJob
{
    std::string source;
    std::string output;
    std::string clip = {}; ///< of a source with several clips; empty for the longest
};

enum class EConversion : uint8_t
{
    Converted,
    Planned, ///< with --dry-run: it would be converted
    Skipped, ///< with --skip-existing: the output exists
    Failed,
};

/// Returns "converted", "failed", ...
const char* OutcomeName(EConversion outcome);

/// What the process does after a conversion.
enum class EProcess : uint8_t
{
    GoesOn,
    Ends, ///< ends, so its motions need not be freed
};

/// What a conversion prints of its result and its messages. JSON is printed in any case.
enum class EVoice : uint8_t
{
    Speaks,
    Failures, ///< only failures
    Silent,   ///< nothing; the summary of the run says what is needed
};

/// What a conversion uses besides its source. Null pointers are allowed.
struct ConversionTools
{
    std::FILE* record = nullptr; ///< receives the --json output and the key figures
    CPagePart* part = nullptr;   ///< receives the conversion's pictures and figures
    CDraftShelf* drafts = nullptr;
    EVoice voice = EVoice::Speaks;
    EProcess process = EProcess::GoesOn;
};

/// Runs one conversion like the desktop program: open, choose a profile, convert, save. Prints the result to
/// standard output and everything else to standard error. Keeps no state for the next source.
EConversion ConvertFile(const ShellOptions& options, const ConversionJob& job, const ConversionTools& tools);

/// Converts a source in memory and draws the part of a page about it. Writes no file and prints nothing; if
/// the conversion fails, the part stays empty.
void DrawConversion(const ShellOptions& options, const ConversionJob& job, const ConversionTools& tools);

/// Reports, in the same format, a conversion that failed for a reason it could not report itself.
void TellFailed(const ShellOptions& options, const ConversionJob& job, const Notice& reason,
                const ConversionTools& tools);
/// Reports, in the same format, a skipped conversion.
void TellSkipped(const ShellOptions& options, const ConversionJob& job, const char* why, EVoice voice);

} // namespace gw
