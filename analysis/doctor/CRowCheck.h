#pragma once

#include "BVHOutline.h"
#include "CLineCursor.h"
#include "CRowTable.h"
#include "Fault.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

class CFindings;

/// What a mended copy does with the rows, beside the values that it gives anew.
struct RowPlan
{
    size_t rowCount = 0;            ///< rows of the copy, which are the first ones of the text
    bool dropsLast = false;         ///< the row behind them is left out
    bool correctsCount = false;     ///< the number of frames becomes rowCount
    std::vector<float> subtrahends; ///< for each column, what is taken off its values; empty for nothing
};

/// Reads the rows of a BVH text: finds those that are short, long, missing, too many or of no numbers, and
/// mends single values by their neighbours.
class CRowCheck
{
public:
    CRowCheck(const BVHOutline& outline, CFindings& findings) : outline_(outline), findings_(findings) {}

    /// Reads from the cursor on.
    void Read(CLineCursor& lines);

    CRowTable& Table() { return m_kTable; }
    RowPlan& Plan() { return m_kPlan; }

private:
    struct BadToken
    {
        size_t column;
        std::string_view text;
        EFault fault;
    };
    struct BadCell
    {
        uint32_t row;
        uint32_t column;
    };

    bool IsPastRows(std::string_view line) const;
    void ReadRow(std::string_view row, size_t line);
    size_t ReadValues(std::string_view row);
    void JudgeToken(std::string_view token, size_t column);
    void TellBadTokens(bool whole, size_t line);
    void TellEmptyLines();
    void TellShortRow(bool isLast);
    void CompareCounts();
    bool IsRotation(size_t column) const;
    void MendCells();
    bool MeanOfNeighbours(const BadCell& cell, float& value) const;

    const BVHOutline& outline_;
    CFindings& findings_;
    CRowTable m_kTable;
    RowPlan m_kPlan;
    std::vector<float> m_kRow;
    std::vector<BadToken> m_kBadTokens; // of the row at hand
    std::vector<BadCell> m_kBadCells;   // of all rows that are whole
    size_t m_uiFirstEmptyLine = 0;      // of those that are not told yet: whether rows follow is not known
    size_t m_uiEmptyLines = 0;
    size_t m_uiShortLine = 0; // of the row before, where it was short; 0 where it was not
    size_t m_uiRows = 0;      // of all kinds
};

} // namespace gw
