#pragma once

#include "BVHOutline.h"
#include "CLineCursor.h"
#include "CRowTable.h"
#include "Finding.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

class CFindings;

/// What a repaired copy does with the rows, apart from the changed values.
struct RowPlan
{
    size_t rowCount = 0;            ///< the copy keeps this many rows from the start of the text
    bool dropsLast = false;         ///< leaves out the row after them
    bool correctsCount = false;     ///< sets the frame count to rowCount
    std::vector<float> subtrahends; ///< per column, the number to subtract from its values; empty if unused
};

/// Checks the rows of a BVH text: finds rows that are short, long, missing, in excess or not numeric, and
/// repairs single values from their neighbors.
class CRowCheck
{
public:
    CRowCheck(const BVHOutline& outline, CFindings& findings) : outline_(outline), findings_(findings) {}

    /// Reads from the cursor to the end.
    void Read(CLineCursor& lines);

    CRowTable& Table() { return m_kTable; }
    RowPlan& Plan() { return m_kPlan; }

private:
    struct BadToken
    {
        size_t column;
        std::string_view text;
        EFailure reason;
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
    std::vector<BadToken> m_kBadTokens; // of the current row
    std::vector<BadCell> m_kBadCells;   // of all complete rows
    size_t m_uiFirstEmptyLine = 0;      // of those not yet reported, since it is unknown whether rows follow
    size_t m_uiEmptyLines = 0;
    size_t m_uiShortLine = 0; // line of the previous row if that was short, otherwise 0
    size_t m_uiRows = 0;      // all rows, complete or not
};

} // namespace gw
