// The half of CHTRReader that reads numbers: base positions and rows.

#include "CHTRReader.h"
#include "CTextLines.h"
#include "Numbers.h"
#include "ReadFloat.h"
#include "TKHTRFile.h"
#include "Text.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

constexpr size_t kBytesPerRow = 2; // a frame number and a line feed

bool IsSeparator(char c)
{
    return c == ' ' || c == ',' || (c >= '\t' && c <= '\r');
}

std::string_view SkipSeparators(std::string_view text)
{
    return {std::ranges::find_if_not(text, IsSeparator), text.end()};
}

// Skips a number as "%d" does. False if there are no digits.
bool SkipInteger(std::string_view& text)
{
    text = SkipSeparators(text);
    if (text.starts_with('-') || text.starts_with('+'))
        text.remove_prefix(1);
    const size_t digits = std::min(text.find_first_not_of("0123456789"), text.size());
    text.remove_prefix(digits);
    return digits > 0;
}

} // namespace

bool CHTRReader::ReadBasePosition(std::string_view)
{
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!ReadBaseLine(line))
            return false;
    }
    return true;
}

bool CHTRReader::ReadBaseLine(std::string_view line)
{
    const std::string_view name = NextWord(line);
    const auto found = file_.segmentOfName.find(name);
    if (found == file_.segmentOfName.end())
    {
        Warn(EFailure::UnknownSegment, name);
        return true;
    }
    float numbers[7] = {};
    size_t count = 0;
    if (!ReadNumbers(line, numbers, count))
        return false;
    if (count < std::size(numbers))
        Warn(EFailure::ShortRow, name);
    TKHTRSegment& segment = *found->second;
    segment.baseTranslation = {numbers[0], numbers[1], numbers[2]};
    segment.baseRotation = {numbers[3], numbers[4], numbers[5]};
    segment.boneLength = numbers[6];
    return true;
}

bool CHTRReader::ReadSegment(std::string_view section)
{
    const std::string_view name = NextToken(section, "[]");
    const auto found = file_.segmentOfName.find(name);
    if (found == file_.segmentOfName.end())
        return Fail(EFailure::UnknownSegment, name);
    TKHTRSegment& segment = *found->second;
    ReserveRows(segment);
    float row[7] = {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 1.0f};
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!ReadRow(segment, line, row))
            return false;
        lines_.ForgetRead();
    }
    return true;
}

// Only if the file can hold that many rows for all segments, and not for a second section with the same name,
// because each exact reservation copies the array.
void CHTRReader::ReserveRows(TKHTRSegment& segment)
{
    const auto frames = static_cast<size_t>(std::max(file_.numFrames, 0));
    if (!segment.scales.empty() || frames > lines_.ByteCount() / kBytesPerRow / file_.segmentOfName.size())
        return;
    segment.translations.reserve(frames);
    segment.rotations.reserve(frames);
    segment.scales.reserve(frames);
}

// Reads a row. The frame number is ignored: rows count in file order. Missing values, even all of them, are
// taken from the previous row.
bool CHTRReader::ReadRow(TKHTRSegment& segment, std::string_view line, std::span<float, 7> row)
{
    size_t count = 0;
    if (!SkipInteger(line))
        return Fail(EFailure::BadNumber, NextWord(line));
    if (!ReadNumbers(line, row, count))
        return false;
    if (count < row.size())
        Warn(EFailure::ShortRow, segment.name);
    segment.translations.push_back({row[0], row[1], row[2]});
    segment.rotations.push_back({row[3], row[4], row[5]});
    segment.scales.push_back(row[6]);
    return true;
}

// Reads numbers as sscanf does: characters directly after one start the next. Commas separate like blanks.
bool CHTRReader::ReadNumbers(std::string_view text, std::span<float, 7> numbers, size_t& count)
{
    for (count = 0; count < numbers.size(); ++count)
    {
        text = SkipSeparators(text);
        if (text.empty())
            return true;
        ENumber kind;
        const char* next;
        const float value = ReadFloat(text.data(), text.data() + text.size(), next, kind);
        std::string_view copy = text;
        if (kind == ENumber::None || kind == ENumber::Unusual)
            return Fail(EFailure::BadNumber, NextToken(copy));
        if (kind == ENumber::Stuck)
            Warn(EFailure::StuckNumber, NextToken(copy));
        numbers[count] = value;
        text.remove_prefix(static_cast<size_t>(next - text.data()));
    }
    return true;
}

} // namespace gw
