// The rows of a bone map as texts, as the list shows them. Numbers are parsed when they are used.

#include "CMapRowTable.h"

#include "HostBones.h"
#include "Numbers.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kAxisCount = 3;

void WriteRotation(CMapRowTable::Row& row, const RowNumbers& numbers)
{
    for (size_t axis = 0; axis < kAxisCount; ++axis)
        row[kRotationColumn + axis] = std::to_string(numbers.rotation[axis]);
}

void WriteAxes(CMapRowTable::Row& row, const AxisCodes& axes)
{
    const bool neutral = axes == kNeutralAxes;
    for (size_t axis = 0; axis < kAxisCount; ++axis)
        row[kAxisColumn + axis] = neutral ? std::string_view() : AxisText(axes[axis]);
}

} // namespace

const std::string& CMapRowTable::Text(int row, int column) const
{
    static const std::string kNoText;
    return Has(row) ? m_kRows[Index(row)][static_cast<size_t>(column)] : kNoText;
}

bool CMapRowTable::IsFixed(int row) const
{
    return EqualNoCase(Text(row, kSourceColumn), kFixedSource);
}

RowNumbers CMapRowTable::Numbers(int row) const
{
    RowNumbers numbers;
    for (int axis = 0; axis < static_cast<int>(kAxisCount); ++axis)
    {
        numbers.rotation[Index(axis)] = ParseInt(Text(row, kRotationColumn + axis));
        const std::string& text = Text(row, kAxisColumn + axis);
        if (!text.empty())
            numbers.axes[Index(axis)] = AxisCodeOf(text);
    }
    return numbers;
}

int CMapRowTable::FindTarget(std::string_view target) const
{
    if (m_kRowOfTarget.empty())
        IndexTargets();
    const auto found = m_kRowOfTarget.find(LowerCase(target));
    return found == m_kRowOfTarget.end() ? kNone : found->second;
}

void CMapRowTable::IndexTargets() const
{
    for (int row = 0; row < RowCount(); ++row)
        m_kRowOfTarget.emplace(LowerCase(Text(row, kTargetColumn)), row);
}

void CMapRowTable::AddRow(std::string_view source, std::string_view target, const RowNumbers& numbers,
                          ERowColumns columns)
{
    if (m_kRowOfTarget.empty())
        IndexTargets();
    const auto [found, isNew] = m_kRowOfTarget.try_emplace(LowerCase(target), RowCount());
    if (isNew)
    {
        m_kRows.emplace_back()[kSourceColumn] = source;
        m_kSelected.push_back(false);
    }
    Row& row = m_kRows[Index(found->second)];
    row[kTargetColumn] = target;
    // The first row keeps its initial rotation.
    if (isNew || found->second != 0)
        WriteRotation(row, numbers);
    if (columns == ERowColumns::All)
        WriteAxes(row, numbers.axes);
}

void CMapRowTable::AddPelvisRows()
{
    for (const std::string_view pelvis : kPelvisBones)
        AddRow(kFixedSource, pelvis, {}, ERowColumns::NamesAndRotation);
}

void CMapRowTable::RemoveRow(int row)
{
    if (!Has(row))
        return;
    m_kRows.erase(m_kRows.begin() + row);
    m_kSelected.erase(m_kSelected.begin() + row);
    m_kRowOfTarget.clear();
}

void CMapRowTable::Clear()
{
    m_kRows.clear();
    m_kSelected.clear();
    m_kRowOfTarget.clear();
}

void CMapRowTable::Select(int row, bool selected)
{
    if (Has(row))
        m_kSelected[Index(row)] = selected;
}

void CMapRowTable::SelectOnly(int row)
{
    std::fill(m_kSelected.begin(), m_kSelected.end(), false);
    Select(row, true);
}

int CMapRowTable::SelectedCount() const
{
    return static_cast<int>(std::count(m_kSelected.begin(), m_kSelected.end(), true));
}

bool CMapRowTable::IsFixedSelected() const
{
    for (int row = NextSelected(kNone); row != kNone; row = NextSelected(row))
    {
        if (IsFixed(row))
            return true;
    }
    return false;
}

int CMapRowTable::NextSelected(int after) const
{
    for (int row = after + 1; row < RowCount(); ++row)
    {
        if (m_kSelected[Index(row)])
            return row;
    }
    return kNone;
}

} // namespace gw
