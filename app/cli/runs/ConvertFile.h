#pragma once

#include "ShellOptions.h"

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

namespace gw {

class CPagePart;
struct CReport;

/// One source and the file that becomes of it.
struct ConversionJob
{
    std::string source;
    std::string output;
};

enum class EConversion : uint8_t
{
    Converted,
    Planned, ///< with --dry-run: it would be converted
    Skipped, ///< the output is there, with --skip-existing
    Failed,
};

/// "converted", "failed", ...
const char* OutcomeName(EConversion outcome);

/// What the process does after a conversion.
enum class EProcess : uint8_t
{
    GoesOn,
    Ends, ///< its motions need not be freed
};

/// Runs one conversion as the desktop program does: open, choose a profile, convert, save. Tells the result
/// on standard output and everything else on standard error. Nothing of one source stays for the next. A
/// record, unless it is null, takes what --json tells and the key figures, and a part of a page the
/// conversion's pictures and figures.
EConversion ConvertFile(const ShellOptions& options, const ConversionJob& job, std::FILE* record,
                        CPagePart* part, EProcess process = EProcess::GoesOn);

/// Tells in the same way of a conversion that came to nothing, for a reason that it could not tell itself.
void TellFailed(const ShellOptions& options, const ConversionJob& job, const CReport& reason,
                std::FILE* record);
/// And of one that is not made.
void TellSkipped(const ShellOptions& options, const ConversionJob& job, const char* why);

} // namespace gw
