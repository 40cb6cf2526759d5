// The mender copies the rows and changes only what the plan names, so a mended file differs from the
// original in as few bytes as possible. It walks over the text and the list of replaced cells in parallel.
// Both are in row order, so one pass over each is enough. Values without a change are copied as they are
// written, because printing a parsed number again could change digits. Output is written in blocks of a
// megabyte, so memory does not grow with the file.

#include "CRowMender.h"

#include "BVHOutline.h"
#include "CLineCursor.h"
#include "NumberText.h"
#include "Numbers.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kWriteBytes = size_t{1} << 20;

} // namespace

bool CRowMender::Write(std::string_view text, const CTextSink& write)
{
    CLineCursor lines(text, outline_.rowsBegin, outline_.rowsLine);
    const size_t rows = plan_.rowCount + plan_.dropsLast;
    for (size_t row = 0; row < rows && lines.Next();)
    {
        if (lines.IsBlank() || ++row > plan_.rowCount)
            continue;
        AppendRow(lines.Line());
        const size_t end = lines.OffsetOf(lines.Line()) + lines.Line().size();
        m_kOut += text.substr(end, lines.NextOffset() - end);
        if (m_kOut.size() < kWriteBytes)
            continue;
        if (!write(m_kOut))
            return false;
        m_kOut.clear();
    }
    return write(m_kOut) && write(text.substr(lines.NextOffset()));
}

void CRowMender::AppendRow(std::string_view row)
{
    std::string points;
    if (HasDecimalCommas(row, outline_.columnCount))
    {
        points = WithPoints(row);
        row = points;
    }
    const bool whole = CountTokens(row) >= outline_.columnCount;
    if (whole && Changes())
        AppendValues(row);
    else
        m_kOut += row;
    m_uiWhole += whole;
}

bool CRowMender::IsCellOf(size_t column) const
{
    return IsCellOfRow() && m_kCells[m_uiNextCell].column == column;
}

bool CRowMender::IsCellOfRow() const
{
    return m_uiNextCell < m_kCells.size() && m_kCells[m_uiNextCell].row == m_uiWhole;
}

bool CRowMender::Changes() const
{
    return !plan_.subtrahends.empty() || IsCellOfRow();
}

void CRowMender::AppendValues(std::string_view row)
{
    const char* at = row.data();
    std::string_view rest = row;
    for (size_t column = 0; column < outline_.columnCount; ++column)
    {
        const std::string_view token = NextToken(rest);
        m_kOut.append(at, token.data()); // the original blanks
        AppendValue(token, column);
        at = token.data() + token.size();
    }
    m_kOut += rest;
}

void CRowMender::AppendValue(std::string_view token, size_t column)
{
    const float less = plan_.subtrahends.empty() ? 0.0f : plan_.subtrahends[column];
    const bool mended = IsCellOf(column);
    double value = ParseDouble(token);
    while (IsCellOf(column)) // the later of two repairs counts
        value = static_cast<double>(m_kCells[m_uiNextCell++].value);
    if (mended || (less != 0.0f && !FailureOfNumber(token)))
        AppendFixed6(m_kOut, static_cast<float>(value - static_cast<double>(less)));
    else
        m_kOut += token;
}

} // namespace gw
