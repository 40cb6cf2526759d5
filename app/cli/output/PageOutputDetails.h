#pragma once

#include "ConvertFile.h"

#include <span>

namespace gw {

class CConversionPage;
class CDraftShelf;
struct ShellOptions;

/// Adds details of the worst conversions to a page of a run, where they are missing: most conversions of a
/// large run, and those that were skipped because their results were up to date, are not drawn when they run.
/// They are converted again in memory, in worker processes; nothing is written or printed. A source that
/// cannot be converted any more gets no details. `jobs` are the page's sources, in order.
void AddPageDetails(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                    CConversionPage& page);

} // namespace gw
