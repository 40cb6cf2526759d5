// Reads CHA files. The format is line based and its readers have always been lenient, which this one
// preserves: a line starting below "?" is a remark (as a signed character, so any non-ASCII letter too), an
// empty line ends the header, headers can be nested, and a row with too few numbers repeats the previous
// frame's values. All counts in the header are limited by what the remaining bytes can hold.

#include "CCHAReader.h"

#include "CTextLines.h"
#include "MotionNode.h"
#include "Numbers.h"
#include "ReadFloat.h"
#include "Text.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

constexpr signed char kFirstOfNames = '?'; // section lines starting with a lower character are remarks
constexpr size_t kBytesPerRow = 2;         // a name and a line feed

struct KeyRow
{
    std::string_view name;
    int TKCHFile::*field;
};

constexpr KeyRow kKeys[] = {
    {"VersionNumber", &TKCHFile::versionNumber},
    {"DataFrameRate", &TKCHFile::dataFrameRate},
    {"BeginFrame",    &TKCHFile::beginFrame   },
    {"EndFrame",      &TKCHFile::endFrame     },
    {"NumSegments",   &TKCHFile::numSegments  },
};

// The character is signed, so names starting with a non-ASCII letter are remarks too.
bool IsRemark(std::string_view line)
{
    return line.empty() || static_cast<signed char>(line[0]) < kFirstOfNames;
}

std::string_view SkipBlanks(std::string_view text)
{
    const auto isBlank = [](char c) { return c == ' ' || (c >= '\t' && c <= '\r'); };
    return {std::ranges::find_if_not(text, isBlank), text.end()};
}

} // namespace

const CCHAReader::HandlerRow CCHAReader::kHandlers[] = {
    {"[HEADER]",    &CCHAReader::OpenHeader   },
    {"[LENGTH]",    &CCHAReader::ReadLengths  },
    {"[HIERARCHY]", &CCHAReader::ReadHierarchy},
    {"[MOTION]",    &CCHAReader::ReadMotion   },
};

bool CCHAReader::Fail(EFailure reason, std::string_view name)
{
    return record_.Fail(reason, lines_.LineNumber(), Quote(name));
}

void CCHAReader::Warn(EFailure reason, std::string_view name)
{
    record_.Warn(reason, lines_.LineNumber(), Quote(name));
}

bool CCHAReader::Read()
{
    for (std::string_view rest; lines_.Next(rest);)
    {
        const std::string_view word = NextToken(rest);
        if (word.empty() && m_uiOpenHeaders == 0)
            return CheckFile(EFailure::BlankLine);
        if (word.empty())
            CloseHeader();
        else if (!ReadWord(word, rest))
            return false;
    }
    // The end of the file also closes a header, but by then the motion has been read with 0 frames.
    if (m_uiOpenHeaders > 0)
        CloseHeader();
    return CheckFile(EFailure::MissingSection);
}

bool CCHAReader::ReadWord(std::string_view word, std::string_view rest)
{
    const auto section = std::ranges::find(kHandlers, word, &HandlerRow::section);
    if (section != std::end(kHandlers))
        return (this->*section->read)();
    const auto key = std::ranges::find(kKeys, word, &KeyRow::name);
    return key == std::end(kKeys) || ReadKey(word, file_.*key->field, rest);
}

// A key without a value keeps its default, like a missing key.
bool CCHAReader::ReadKey(std::string_view key, int& field, std::string_view rest)
{
    const std::string_view token = NextToken(rest);
    if (token.empty())
    {
        Warn(EFailure::MissingTokens, key);
        return true;
    }
    if (!ScanInt(token, field))
        return Fail(EFailure::BadNumber, token);
    if (file_.numSegments > kSegmentLimit)
        return Fail(EFailure::TooLarge, key);
    return file_.beginFrame >= 0 || Fail(EFailure::BadNumber, token);
}

bool CCHAReader::OpenHeader()
{
    ++m_uiOpenHeaders;
    return true;
}

void CCHAReader::CloseHeader()
{
    --m_uiOpenHeaders;
    file_.CountFrames();
}

// Reads the next line that is not a remark. At the start of a section, returns false with the cursor before
// it.
bool CCHAReader::NextSectionLine(std::string_view& line)
{
    while (lines_.Next(line))
    {
        if (line.starts_with('['))
        {
            lines_.StepBack();
            return false;
        }
        if (!IsRemark(line))
            return true;
    }
    return false;
}

bool CCHAReader::ReadLengths()
{
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!ReadLength(line))
            return false;
    }
    return true;
}

bool CCHAReader::ReadLength(std::string_view line)
{
    const std::string_view name = NextWord(line);
    const std::string_view number = NextWord(line);
    if (number.empty())
    {
        Warn(EFailure::MissingTokens, name);
        return true;
    }
    float length = 0.0f;
    ENumber kind;
    if (!ScanFloat(number, length, kind) || kind == ENumber::Unusual)
        return Fail(EFailure::BadNumber, number);
    file_.lengths.emplace_back(name, length);
    return true;
}

bool CCHAReader::ReadHierarchy()
{
    file_.MakeRoot();
    bool allCount = true;
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!AddSegment(line, allCount))
            return false;
    }
    if (!allCount)
        Warn(EFailure::BadCount, "NumSegments");
    file_.LinkSegments(record_, lines_.LineNumber());
    return true;
}

// Segments beyond the header's count are never attached, so they are not kept.
bool CCHAReader::AddSegment(std::string_view line, bool& counts)
{
    const std::string_view name = NextWord(line);
    const std::string_view parentName = NextWord(line);
    if (!MayBeName(name) || !MayBeName(parentName))
        return Fail(EFailure::BadName, name);
    counts = std::ssize(file_.segments) < file_.numSegments;
    if (counts)
        file_.AddSegment(name, parentName);
    return true;
}

bool CCHAReader::ReadMotion()
{
    m_bHasMotion = true;
    if (!file_.FirstRoot())
        return CheckFile(EFailure::MissingSection);
    if (m_uiOpenHeaders > 0 && file_.frameCount == 0)
        Warn(EFailure::OpenHeader, "[HEADER]");
    if (!ReservePlaces())
        return Fail(EFailure::TooFewRows, "EndFrame");
    size_t index = 0;
    for (std::string_view line; lines_.Next(line);)
    {
        if (IsRemark(line))
            continue;
        if (line.starts_with('F'))
            index = 0;
        else if (!ReadRow(index++, line))
            return false;
        lines_.ForgetRead();
    }
    return TakeFrames();
}

std::span<CCHAReader::Place> CCHAReader::CountedPlaces()
{
    return std::span(m_kPlaces).first(static_cast<size_t>(std::max(file_.numSegments, 0)));
}

// Reserves the frames; false if the remaining bytes cannot hold that many rows.
bool CCHAReader::ReservePlaces()
{
    const auto frames = static_cast<size_t>(file_.frameCount);
    if (frames == 0)
        return true;
    const size_t needed = static_cast<size_t>(file_.beginFrame) + frames;
    if (needed > (lines_.BytesLeft() + 1) / kBytesPerRow / std::max<size_t>(CountedPlaces().size(), 1))
        return false;
    for (Place& place : CountedPlaces())
    {
        place.segment.matrices.reserve(frames);
        place.segment.positions.reserve(frames);
    }
    return true;
}

bool CCHAReader::ReadRow(size_t index, std::string_view line)
{
    const std::string_view name = NextWord(line);
    if (index >= m_kPlaces.size())
        return Fail(EFailure::TooLarge, name);
    if (!MayBeName(name))
        return Fail(EFailure::BadName, name);
    Place& place = m_kPlaces[index];
    size_t count = 0;
    if (!ReadNumbers(line, place.row, count))
        return false;
    const bool counts = index < CountedPlaces().size();
    if (counts && count < place.row.size())
        Warn(EFailure::ShortRow, name);
    // A row without values does not rename its segment: in a truncated file, the last row can be half a name.
    if (count > 0 || place.rowCount == 0)
        place.segment.name = name;
    const auto begin = static_cast<size_t>(file_.beginFrame);
    const size_t row = place.rowCount++;
    if (!counts || row < begin || row - begin >= static_cast<size_t>(file_.frameCount))
        return true;
    place.segment.matrices.emplace_back();
    std::copy_n(place.row.data(), 9, place.segment.matrices.back().m);
    place.segment.positions.push_back({place.row[9], place.row[10], place.row[11]});
    return true;
}

// Reads numbers as sscanf does, each followed by a comma: blanks are allowed before a number, but not before
// a comma. If one is missing, the rest keep their values.
bool CCHAReader::ReadNumbers(std::string_view text, Row& row, size_t& count)
{
    for (count = 0; count < row.size(); ++count)
    {
        if (count > 0 && !text.starts_with(','))
            return true;
        text = SkipBlanks(text.substr(count > 0 ? 1 : 0));
        if (text.empty() || text.starts_with(','))
            return true;
        const char* next;
        ENumber kind;
        const float value = ReadFloat(text.data(), text.data() + text.size(), next, kind);
        if (kind == ENumber::None || kind == ENumber::Unusual)
            return Fail(EFailure::BadNumber, NextToken(text));
        row[count] = value;
        text.remove_prefix(static_cast<size_t>(next - text.data()));
    }
    return true;
}

// Moves the frames to the records named by the rows; if a name occurs twice, the first row's frames are used.
bool CCHAReader::TakeFrames()
{
    for (Place& place : CountedPlaces())
    {
        const auto frames = static_cast<size_t>(file_.frameCount);
        if (frames > 0 && place.rowCount < static_cast<size_t>(file_.beginFrame) + frames)
            return Fail(EFailure::TooFewRows, place.segment.name);
        TakeFrames(place);
    }
    for (const auto& segment : file_.segments)
    {
        if (file_.frameCount > 0 && segment->matrices.empty() && file_.FindSegment(segment->name))
            Warn(EFailure::TooFewRows, segment->name);
    }
    return true;
}

void CCHAReader::TakeFrames(Place& place)
{
    TKCHSegment* const segment = file_.FindSegment(place.segment.name);
    if (segment && segment->matrices.empty())
    {
        segment->matrices = std::move(place.segment.matrices);
        segment->positions = std::move(place.segment.positions);
    }
    else if (place.rowCount > 0 && !segment)
        Warn(EFailure::UnknownSegment, place.segment.name);
}

bool CCHAReader::CheckFile(EFailure end)
{
    if (!file_.root)
        return Fail(end, "[HIERARCHY]");
    if (!file_.FirstRoot())
        return Fail(EFailure::NoRoot, file_.numSegments > 0 ? "Global" : "NumSegments");
    if (!m_bHasMotion)
        return Fail(EFailure::MissingSection, "[MOTION]");
    return KeyTimesFit(file_.frameCount, file_.segments.size(), lines_.ByteCount()) ||
           Fail(EFailure::BadCount, "EndFrame");
}

} // namespace gw
