#pragma once

#include "COptions.h"

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CConversionPage;

/// One source and the file that becomes of it.
struct CConversionJob
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

/// Runs one conversion as the desktop program does: open, choose a profile, convert, save. Tells the result
/// on standard output and everything else on standard error. Each has a state machine of its own, so that
/// nothing of one source stays for the next. `page`, where there is one, takes the conversion in.
EConversion ConvertFile(const COptions& options, const CConversionJob& job, CConversionPage* page);

} // namespace gw
