#pragma once

#include "ShellOptions.h"

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

namespace gw {

class CPagePart;
struct Notice;

/// A source and its output file.
struct ConversionJob
{
    std::string source;
    std::string output;
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

/// Runs one conversion like the desktop program: open, choose a profile, convert, save. Prints the result to
/// standard output and everything else to standard error. Keeps no state for the next source. `record`,
/// unless null, receives the --json output and the key figures; `part`, unless null, receives the
/// conversion's pictures and figures.
EConversion ConvertFile(const ShellOptions& options, const ConversionJob& job, std::FILE* record,
                        CPagePart* part, EProcess process = EProcess::GoesOn);

/// Reports, in the same format, a conversion that failed for a reason it could not report itself.
void TellFailed(const ShellOptions& options, const ConversionJob& job, const Notice& reason,
                std::FILE* record);
/// Reports, in the same format, a skipped conversion.
void TellSkipped(const ShellOptions& options, const ConversionJob& job, const char* why);

} // namespace gw
