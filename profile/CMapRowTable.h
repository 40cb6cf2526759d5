#pragma once

#include "ProfileFile.h"

#include <array>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

/// Columns of the row table. Numbers stand in it as texts.
enum EMapColumn : int
{
    kSourceColumn = 0,
    kTargetColumn = 1,
    kRotationColumn = 2, ///< X, Y and Z
    kAxisColumn = 5,     ///< X, Y and Z; empty where neutral
    kMapColumnCount = 8,
};

/// How a column is shown. Widths are shares of the table's width, divided as integers.
struct MapColumnTitle
{
    int messageId; ///< 0 where the title is a blank
    bool alignRight;
    int widthNumerator;
    int widthDenominator;
};

/// The titles of the eight columns and of a ninth, empty one that fills the rest.
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

/// Which columns AddRow writes.
enum class ERowColumns
{
    All,
    NamesAndRotation, ///< the axes stay as they are
};

/// The rows of a bone map, at most one for each target bone, and which of them are selected.
class CMapRowTable
{
public:
    static constexpr int kNone = -1;

    using Row = std::array<std::string, kMapColumnCount>;

    int RowCount() const { return static_cast<int>(m_kRows.size()); }
    /// The text in a row and column; empty for a row that is none.
    const std::string& Text(int row, int column) const;
    bool IsFixed(int row) const;
    /// Rotation and axes of a row as numbers. An empty axis is the neutral one.
    RowNumbers Numbers(int row) const;
    /// The row of a target bone without regard to case, or kNone.
    int FindTarget(std::string_view target) const;
    /// Whether all texts are equal, whatever is selected.
    bool HasSameRows(const CMapRowTable& other) const { return m_kRows == other.m_kRows; }

    /// Appends a row, or changes the one of the same target. A row's source never changes, and the row at
    /// index 0 keeps the rotation that it was added with.
    void AddRow(std::string_view source, std::string_view target, const RowNumbers& numbers,
                ERowColumns columns);
    /// Sees to it that each of the bones that no source drives has a row. New rows are fixed ones.
    void AddPelvisRows();
    /// Nothing for a row that is none.
    void RemoveRow(int row);
    void Clear();

    void Select(int row, bool selected);
    /// Makes a row the only selected one; with kNone none is.
    void SelectOnly(int row);
    bool IsSelected(int row) const { return Has(row) && m_kSelected[Index(row)]; }
    int SelectedCount() const;
    bool IsFixedSelected() const;
    /// The first selected row behind an index, or kNone; kNone begins at the start.
    int NextSelected(int after) const;

private:
    static size_t Index(int row) { return static_cast<size_t>(row); }
    bool Has(int row) const { return row >= 0 && row < RowCount(); }
    void IndexTargets() const;

    std::deque<Row> m_kRows;       // Remove All takes rows off the front
    std::vector<bool> m_kSelected; // one for each row
    // By target in small letters; empty after a removal, which moves rows, until somebody looks for one. A
    // file can name thousands of targets, and each row that it adds looks for its own.
    mutable std::unordered_map<std::string, int> m_kRowOfTarget;
};

} // namespace gw
