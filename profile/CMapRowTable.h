#pragma once

#include "ProfileFile.h"

#include <array>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

/// Columns of the row table. Numbers are stored as text.
enum EMapColumn : int
{
    kSourceColumn = 0,
    kTargetColumn = 1,
    kRotationColumn = 2, ///< X, Y and Z
    kAxisColumn = 5,     ///< X, Y and Z; empty if neutral
    kMapColumnCount = 8,
};

/// How a column is displayed. Widths are fractions of the table's width, by integer division.
struct MapColumnTitle
{
    int messageId; ///< 0 if the title is a blank
    bool alignRight;
    int widthNumerator;
    int widthDenominator;
};

/// Titles of the eight columns and of a ninth, empty one that fills the rest.
inline constexpr MapColumnTitle kMapColumnTitles[] = {
    {149, false, 6, 25},
    {150, false, 6, 25},
    {151, true,  2, 25},
    {152, true,  2, 25},
    {153, true,  2, 25},
    {168, true,  2, 25},
    {169, true,  2, 25},
    {170, true,  2, 25},
    {0,   true,  1, 19},
};

/// The columns that AddRow writes.
enum class ERowColumns
{
    All,
    NamesAndRotation, ///< the axes are not changed
};

/// The rows of a bone map, at most one per target bone, and their selection.
class CMapRowTable
{
public:
    static constexpr int kNone = -1;

    using Row = std::array<std::string, kMapColumnCount>;

    int RowCount() const { return static_cast<int>(m_kRows.size()); }
    /// Returns the text in a row and column; empty for an invalid row.
    const std::string& Text(int row, int column) const;
    /// Returns true if the target bone of a row has no source.
    bool IsFixed(int row) const;
    /// Returns a row's rotation and axes as numbers. An empty axis is the neutral one.
    RowNumbers Numbers(int row) const;
    /// Returns the row of a target bone, ignoring case, or kNone.
    int FindTarget(std::string_view target) const;
    /// Returns whether all texts are equal; the selection is ignored.
    bool HasSameRows(const CMapRowTable& other) const { return m_kRows == other.m_kRows; }

    /// Appends a row, or changes the one with the same target. A row's source never changes, and row 0 keeps
    /// its initial rotation.
    void AddRow(std::string_view source, std::string_view target, const RowNumbers& numbers,
                ERowColumns columns);
    /// Adds a fixed row for each bone that no source drives, unless it has a row.
    void AddPelvisRows();
    /// Ignored for an invalid row.
    void RemoveRow(int row);
    void Clear();

    void Select(int row, bool selected);
    /// Makes a row the only selected one, or none with kNone.
    void SelectOnly(int row);
    bool IsSelected(int row) const { return Has(row) && m_kSelected[Index(row)]; }
    int SelectedCount() const;
    /// Returns true if any selected row is a fixed one.
    bool IsFixedSelected() const;
    /// Returns the first selected row after an index, or kNone. Start with kNone.
    int NextSelected(int after) const;

private:
    static size_t Index(int row) { return static_cast<size_t>(row); }
    bool Has(int row) const { return row >= 0 && row < RowCount(); }
    void IndexTargets() const;

    std::deque<Row> m_kRows;       // Remove All removes rows from the front
    std::vector<bool> m_kSelected; // one per row
    // By target in lowercase. Cleared by a removal, which moves rows, and rebuilt by the next look-up. A file
    // can name thousands of targets, and each row it adds looks for its own.
    mutable std::unordered_map<std::string, int> m_kRowOfTarget;
};

} // namespace gw
