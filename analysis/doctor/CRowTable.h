#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// One value of the rows that is given anew in a mended copy.
struct MendedCell
{
    uint32_t row;
    uint32_t column;
    float value;
};

/// The values of a motion's rows, as far as rows are whole; a value that is no number is a NaN here until it
/// is mended. Kept column by column, since a joint is looked at over all frames.
class CRowTable
{
public:
    explicit CRowTable(size_t columnCount = 0) : m_kColumns(columnCount) {}

    /// Adds a row of so many values as there are columns, with its line in the text.
    void Append(std::span<const float> values, size_t line);

    size_t ColumnCount() const { return m_kColumns.size(); }
    size_t RowCount() const { return m_kLines.size(); }
    size_t LineOf(size_t row) const { return m_kLines[row]; }
    float At(size_t row, size_t column) const { return m_kColumns[column][row]; }
    std::span<const float> Column(size_t column) const { return m_kColumns[column]; }

    /// Gives a value anew, here and in a mended copy.
    void Mend(size_t row, size_t column, float value);
    /// All values given anew, in the order of the rows.
    std::vector<MendedCell> TakeMended();

private:
    std::vector<std::vector<float>> m_kColumns;
    std::vector<uint32_t> m_kLines; // a text of more lines does not fit into memory
    std::vector<MendedCell> m_kMended;
};

} // namespace gw
