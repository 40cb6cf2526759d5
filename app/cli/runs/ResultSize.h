#pragma once

#include "CReport.h"

#include <optional>

namespace gw {

class CFileConversion;
struct ConversionJob;

/// Why the result of a conversion cannot fit into its file, found before any work is done: a .Kinetra holds
/// less than 2 GiB. Nothing for a result that may fit; the file itself counts then.
std::optional<CReport> WhyTooLarge(const CFileConversion& conversion, const ConversionJob& job);

} // namespace gw
