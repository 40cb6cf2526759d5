#pragma once

#include "CByteSink.h"
#include "CRowCheck.h"
#include "CRowTable.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

class CLineCursor;
struct BVHOutline;

/// Writes the rows of a motion according to a repair plan. Unchanged values keep their spelling, and so do
/// line ends and the text after the rows.
class CRowMender
{
public:
    CRowMender(const BVHOutline& outline, const RowPlan& plan, std::vector<MendedCell> cells)
        : outline_(outline), plan_(plan), m_kCells(std::move(cells))
    {
    }

    /// Writes from the first row to the end of the text. Returns false if `write` did.
    bool Write(std::string_view text, const CTextSink& write);

private:
    void AppendRow(std::string_view row);
    void AppendValues(std::string_view row);
    void AppendValue(std::string_view token, size_t column);
    bool Changes() const;
    bool IsCellOfRow() const;
    bool IsCellOf(size_t column) const;

    const BVHOutline& outline_;
    const RowPlan& plan_;
    std::vector<MendedCell> m_kCells; // in row order
    size_t m_uiNextCell = 0;
    size_t m_uiWhole = 0; // complete rows so far, as the cells count them
    std::string m_kOut;
};

} // namespace gw
