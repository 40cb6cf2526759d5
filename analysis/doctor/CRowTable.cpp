#include "CRowTable.h"

#include <algorithm>
#include <tuple>
#include <utility>

namespace gw {

void CRowTable::Append(std::span<const float> values, size_t line)
{
    for (size_t column = 0; column < values.size(); ++column)
        m_kColumns[column].push_back(values[column]);
    m_kLines.push_back(static_cast<uint32_t>(line));
}

void CRowTable::Mend(size_t row, size_t column, float value)
{
    m_kColumns[column][row] = value;
    m_kMended.push_back({static_cast<uint32_t>(row), static_cast<uint32_t>(column), value});
}

std::vector<MendedCell> CRowTable::TakeMended()
{
    std::ranges::stable_sort(m_kMended, {},
                             [](const MendedCell& cell) { return std::tie(cell.row, cell.column); });
    return std::exchange(m_kMended, {});
}

} // namespace gw
