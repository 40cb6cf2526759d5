#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// A value that a repaired copy changes.
struct MendedCell
{
    uint32_t row;
    uint32_t column;
    float value;
};

/// The values of a motion's complete rows. A value that is not a number is NaN until it is repaired. Stored
/// by column, because a joint is examined over all frames.
class CRowTable
{
public:
    explicit CRowTable(size_t columnCount = 0) : m_kColumns(columnCount) {}

    /// Adds a row with one value per column, and its line in the text.
    void Append(std::span<const float> values, size_t line);

    size_t ColumnCount() const { return m_kColumns.size(); }
    size_t RowCount() const { return m_kLines.size(); }
    size_t LineOf(size_t row) const { return m_kLines[row]; }
    float At(size_t row, size_t column) const { return m_kColumns[column][row]; }
    std::span<const float> Column(size_t column) const { return m_kColumns[column]; }

    /// Changes a value, here and in a repaired copy.
    void Mend(size_t row, size_t column, float value);
    /// Returns all changed values, in row order.
    std::vector<MendedCell> TakeMended();

private:
    std::vector<std::vector<float>> m_kColumns;
    std::vector<uint32_t> m_kLines; // a text with more lines does not fit into memory
    std::vector<MendedCell> m_kMended;
};

} // namespace gw
