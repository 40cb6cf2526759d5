#pragma once

#include "KeyFigures.h"
#include "PageRow.h"

#include <span>
#include <string>
#include <vector>

namespace gw {

class CMarkup;

/// A row of the table, and its rank.
struct RankedRow
{
    const PageRow* row = nullptr;
    std::vector<KeyFigure> figures = {}; ///< empty if nothing was measured
    double badness = 0.0;
    size_t number = 0;       ///< of the source in the run, starting at 1
    bool hasSection = false; ///< the page shows its details
};

/// Returns the rows that did not fail and were reached, worst first; those without figures come last.
std::vector<RankedRow> RankRows(std::span<const PageRow> rows);

/// Appends a section about all failures, grouped by kind, most frequent first; nothing without failures.
void AppendFailures(CMarkup& page, std::span<const PageRow> rows);
/// Appends the number of sources for each outcome and verdict, and the kinds of warnings.
void AppendTotals(CMarkup& page, std::span<const PageRow> rows, std::span<const RankedRow> ranked);
/// Appends the sortable table. Its rows are data that a script in the page shows a few hundred at a time,
/// because ten thousand rows of cells would make the page large and slow.
void AppendRunTable(CMarkup& page, std::span<const RankedRow> ranked);

} // namespace gw
