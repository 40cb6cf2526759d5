// Checks motion rows. A row is compared with the column count of the hierarchy; whether a short row is the
// truncated end of the file or a fault in the middle is known only when the next row arrives, so findings are
// delayed by one row. Missing numbers are interpolated if the gap is short; anything longer is reported but
// not invented.

#include "CRowCheck.h"

#include "CFindings.h"
#include "CTextLines.h"
#include "NumberText.h"
#include "Numbers.h"
#include "ReadFloat.h"
#include "RotationTurns.h"
#include "TKBVHFile.h"
#include "Text.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kLongestGap = 3; // frames without a number that can be interpolated

bool IsSeparator(char c)
{
    return kTokenDelimiters.find(c) != kTokenDelimiters.npos;
}

} // namespace

void CRowCheck::Read(CLineCursor& lines)
{
    m_kTable = CRowTable(outline_.columnCount);
    while (lines.Next())
    {
        if (lines.IsBlank())
        {
            m_uiFirstEmptyLine = m_uiEmptyLines++ == 0 ? lines.Number() : m_uiFirstEmptyLine;
            continue;
        }
        if (IsPastRows(lines.Line()))
            break;
        TellEmptyLines();
        TellShortRow(false);
        ReadRow(lines.Line(), lines.Number());
        ++m_uiRows;
    }
    CompareCounts();
    MendCells();
}

// After the last promised frame, an incomplete row is not counted as a row.
bool CRowCheck::IsPastRows(std::string_view line) const
{
    if (outline_.frameCount > 0 && m_uiRows < static_cast<size_t>(outline_.frameCount))
        return false;
    if (!HasDecimalCommas(line, outline_.columnCount) && CountTokens(line) != outline_.columnCount)
        return true;
    return FailureOfNumber(NextToken(line)).has_value();
}

void CRowCheck::TellEmptyLines()
{
    const EFailure reason = m_uiRows == 0 ? EFailure::EmptyLineBeforeFrames : EFailure::EmptyLineInRows;
    for (size_t i = 0; i < m_uiEmptyLines; ++i)
        findings_.Add(reason, m_uiFirstEmptyLine + i);
    m_uiEmptyLines = 0;
}

// The last row can be left out; leaving out any other would move the following frames forward.
void CRowCheck::TellShortRow(bool isLast)
{
    if (m_uiShortLine == 0)
        return;
    if (isLast && m_uiRows > 1)
        findings_.Add(EFailure::CutRow, m_uiShortLine);
    else
        findings_.AddUnmended(EFailure::CutRow, m_uiShortLine);
    m_kPlan.dropsLast = isLast && m_uiRows > 1;
    m_uiShortLine = 0;
}

void CRowCheck::ReadRow(std::string_view row, size_t line)
{
    std::string points;
    if (HasDecimalCommas(row, outline_.columnCount))
    {
        findings_.Add(EFailure::DecimalComma, line);
        points = WithPoints(row);
        row = points;
    }
    const size_t count = ReadValues(row);
    const bool whole = count >= outline_.columnCount;
    TellBadTokens(whole, line);
    if (count > outline_.columnCount)
        findings_.Add(EFailure::LongRow, line);
    if (whole)
        m_kTable.Append(m_kRow, line);
    else
        m_uiShortLine = line;
}

// Reads as many values as there are columns and returns the number of values in the text.
size_t CRowCheck::ReadValues(std::string_view row)
{
    m_kRow.clear();
    m_kBadTokens.clear();
    const char* text = row.data();
    const char* const end = text + row.size();
    for (;;)
    {
        text = std::find_if_not(text, end, IsSeparator);
        if (text == end)
            return m_kRow.size();
        if (m_kRow.size() == outline_.columnCount)
            return m_kRow.size() + CountTokens({text, end});
        ENumber kind;
        const char* next;
        m_kRow.push_back(ReadFloat(text, end, next, kind));
        if (kind != ENumber::Whole)
        {
            next = std::find_if(text, end, IsSeparator);
            JudgeToken({text, next}, m_kRow.size() - 1);
        }
        text = next;
    }
}

void CRowCheck::JudgeToken(std::string_view token, size_t column)
{
    const EFailure reason = FailureOfNumber(token).value_or(EFailure::NotNumber);
    m_kBadTokens.push_back({column, token, reason});
    if (reason == EFailure::NaN)
        m_kRow[column] = std::nanf("");
}

// A NaN in a complete row is reported once the following rows are known.
void CRowCheck::TellBadTokens(bool whole, size_t line)
{
    const auto row = static_cast<uint32_t>(m_kTable.RowCount());
    for (const BadToken& token : m_kBadTokens)
    {
        if (whole && token.reason == EFailure::NaN)
            m_kBadCells.push_back({row, static_cast<uint32_t>(token.column)});
        else
            findings_.AddUnmended(token.reason, line, Quote(token.text));
    }
}

void CRowCheck::CompareCounts()
{
    TellShortRow(true);
    const auto promised = static_cast<size_t>(std::max(outline_.frameCount, 0));
    m_kPlan.rowCount = m_uiRows - m_kPlan.dropsLast;
    m_kPlan.correctsCount = m_uiRows > 0 && m_kPlan.rowCount != promised;
    if (m_uiRows == 0 && promised == 0)
        findings_.Add(EFailure::NoFrames, outline_.framesLine);
    else if (m_uiRows == 0)
        findings_.AddUnmended(EFailure::MissingRows, outline_.framesLine);
    else if (m_uiRows != promised)
        findings_.Add(m_uiRows < promised ? EFailure::MissingRows : EFailure::SurplusRows,
                      outline_.framesLine);
}

void CRowCheck::MendCells()
{
    std::vector<float> values(m_kBadCells.size());
    for (size_t i = 0; i < values.size(); ++i)
    {
        const size_t line = m_kTable.LineOf(m_kBadCells[i].row);
        if (MeanOfNeighbours(m_kBadCells[i], values[i]))
            findings_.Add(EFailure::NaN, line);
        else
            findings_.AddUnmended(EFailure::NaN, line);
    }
    for (size_t i = 0; i < values.size(); ++i)
    {
        if (std::isfinite(values[i]))
            m_kTable.Mend(m_kBadCells[i].row, m_kBadCells[i].column, values[i]);
    }
}

// Computes a value between those of the nearest frames that have one; at the start and end, the only one.
// Returns false, with a NaN, if the gap is too long.
bool CRowCheck::MeanOfNeighbours(const BadCell& cell, float& value) const
{
    size_t before = cell.row;
    size_t behind = cell.row;
    const auto isGap = [&](size_t row) { return std::isnan(m_kTable.At(row, cell.column)); };
    while (before > 0 && behind - before <= kLongestGap && isGap(before))
        --before;
    while (behind + 1 < m_kTable.RowCount() && behind - before <= kLongestGap + 1 && isGap(behind))
        ++behind;
    const float first = m_kTable.At(isGap(before) ? behind : before, cell.column);
    const float last = m_kTable.At(isGap(behind) ? before : behind, cell.column);
    value = first;
    if (isGap(before) == isGap(behind))
    {
        const float turned = IsRotation(cell.column) ? NearestTurn(last, first) : last;
        const auto share = static_cast<float>(cell.row - before) / static_cast<float>(behind - before);
        value = first + (turned - first) * share;
    }
    if (behind - before > kLongestGap + 1)
        value = std::nanf("");
    return std::isfinite(value);
}

bool CRowCheck::IsRotation(size_t column) const
{
    const auto isBehind = [](size_t at, const OutlineJoint& joint) { return at < joint.firstColumn; };
    const auto joint =
        std::prev(std::upper_bound(outline_.joints.begin(), outline_.joints.end(), column, isBehind));
    const size_t index = column - joint->firstColumn;
    return index < joint->channels.size() && joint->channels[index] >= kFirstRotation &&
           joint->channels[index] < kFirstScale;
}

} // namespace gw
