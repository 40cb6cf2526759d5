#include "CHTRReader.h"

#include "COrrinStream.h"
#include "CTextLines.h"
#include "MotionNode.h"
#include "Numbers.h"
#include "TKHTRFile.h"
#include "Text.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <utility>

namespace gw {

namespace {

constexpr size_t kNameLimit = 255;
constexpr size_t kLongestQuote = 80;                    // of a word in the failure record
constexpr size_t kBytesPerRow = 4;                      // a frame number, a value, a blank and a line feed
constexpr std::string_view kEndSection = "[EndOfFile]"; // closes files of other programs

bool IsSeparator(char c)
{
    return c == ' ' || c == ',' || (c >= '\t' && c <= '\r');
}

std::string_view SkipSeparators(std::string_view text)
{
    return {std::ranges::find_if_not(text, IsSeparator), text.end()};
}

// Passes over a number as "%d" does. False where there are no digits.
bool SkipInteger(std::string_view& text)
{
    text = SkipSeparators(text);
    if (text.starts_with('-') || text.starts_with('+'))
        text.remove_prefix(1);
    const size_t digits = std::min(text.find_first_not_of("0123456789"), text.size());
    text.remove_prefix(digits);
    return digits > 0;
}

bool TakeValue(std::string_view token, std::string& field)
{
    field = token;
    return true;
}

bool TakeValue(std::string_view token, char& field)
{
    field = token[0];
    return true;
}

bool TakeValue(std::string_view token, int& field)
{
    return ScanInt(token, field);
}

bool TakeValue(std::string_view token, float& field)
{
    return ScanFloat(token, field) && std::isfinite(field);
}

} // namespace

const CHTRReader::HandlerRow CHTRReader::kHandlers[] = {
    {"[Header]",                 &CHTRReader::ReadHeader      },
    {"[SegmentNames&Hierarchy]", &CHTRReader::ReadHierarchy   },
    {"[BasePosition]",           &CHTRReader::ReadBasePosition},
};

bool CHTRReader::Fail(EFailure reason, std::string_view name)
{
    return m_kRecord.Fail(reason, m_kLines.LineNumber(), std::string(name.substr(0, kLongestQuote)));
}

void CHTRReader::Warn(EFailure reason, std::string_view name)
{
    m_kRecord.Warn(reason, m_kLines.LineNumber(), std::string(name.substr(0, kLongestQuote)));
}

bool CHTRReader::Read()
{
    for (std::string_view line; m_kLines.Next(line);)
    {
        if (line.starts_with('[') && !ReadSection(NextToken(line)))
            return false;
    }
    return CheckFile();
}

bool CHTRReader::ReadSection(std::string_view section)
{
    const auto known = std::ranges::find(kHandlers, section, &HandlerRow::section);
    if (known != std::end(kHandlers))
        return (this->*known->read)(section);
    if (m_kSegmentSections.contains(section))
        return ReadSegment(section);
    if (section != kEndSection)
        Warn(EFailure::UnknownSegment, section);
    return true;
}

// The next line that is neither empty nor a comment. False, with the cursor before it, where a section
// begins.
bool CHTRReader::NextSectionLine(std::string_view& line)
{
    while (m_kLines.Next(line))
    {
        if (line.starts_with('['))
        {
            m_kLines.StepBack();
            return false;
        }
        std::string_view words = line;
        if (!line.starts_with('#') && !NextWord(words).empty())
            return true;
    }
    return false;
}

bool CHTRReader::ReadHeader(std::string_view)
{
    for (std::string_view rest; m_kLines.Next(rest);)
    {
        const std::string_view key = NextToken(rest);
        if (key.starts_with('['))
        {
            m_kLines.StepBack();
            return true;
        }
        if (!ReadKey(key, rest))
            return false;
    }
    return true;
}

bool CHTRReader::ReadKey(std::string_view key, std::string_view rest)
{
    const auto known = std::ranges::find(kHTRKeys, key, &CHTRKey::name);
    if (known == std::end(kHTRKeys))
        return true;
    const std::string_view token = NextToken(rest);
    if (token.empty())
        return Fail(EFailure::MissingTokens, key);
    if (key == "NumFrames")
        m_uiFramesLine = m_kLines.LineNumber();
    const auto take = [&](auto field) { return TakeValue(token, m_kFile.*field); };
    return std::visit(take, known->field) || Fail(EFailure::BadNumber, token);
}

bool CHTRReader::ReadHierarchy(std::string_view)
{
    m_kFile.segmentOfName.clear();
    m_kFile.segments.clear();
    m_kFile.root = m_kFile.segments.emplace_back(std::make_unique<TKHTRSegment>()).get();
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!AddSegment(line))
            return false;
    }
    LinkSegments();
    return IndexSegments();
}

bool CHTRReader::AddSegment(std::string_view line)
{
    const std::string_view name = NextWord(line);
    const std::string_view parentName = NextWord(line);
    if (name.size() > kNameLimit || parentName.size() > kNameLimit)
        return Fail(EFailure::BadName, name);
    if (m_kFile.segments.size() > kBoneLimit)
        return Fail(EFailure::TooLarge, name);
    auto segment = std::make_unique<TKHTRSegment>();
    segment->name = name;
    segment->parentName = parentName;
    segment->line = m_kLines.LineNumber();
    m_kFile.segments.push_back(std::move(segment));
    return true;
}

// Hangs the segments under their parents, as many as the header counts. Of two equal names the first one is
// meant. Segments that name each other in a ring hang on nothing and are never found again.
void CHTRReader::LinkSegments()
{
    std::unordered_map<std::string_view, TKHTRSegment*> segmentOfName{
        {"GLOBAL", m_kFile.root}
    };
    for (size_t i = 1; i < m_kFile.segments.size(); ++i)
        segmentOfName.emplace(m_kFile.segments[i]->name, m_kFile.segments[i].get());
    const size_t listed = m_kFile.segments.size() - 1;
    const size_t counted = std::min(static_cast<size_t>(std::max(m_kFile.numSegments, 0)), listed);
    for (size_t i = 1; i <= counted; ++i)
    {
        TKHTRSegment& segment = *m_kFile.segments[i];
        const auto parent = segmentOfName.find(segment.parentName);
        if (parent == segmentOfName.end())
        {
            m_kRecord.Warn(EFailure::UnknownSegment, segment.line, segment.parentName);
            continue;
        }
        parent->second->children.push_back(&segment);
        m_kSegmentSections.insert("[" + segment.name + "]");
    }
    if (counted < listed)
        m_kRecord.Warn(EFailure::BadCount, m_kFile.segments[counted + 1]->line, "NumSegments");
}

// Depth first, so that a name means the segment that a search from the root finds.
bool CHTRReader::IndexSegments()
{
    std::vector<std::pair<TKHTRSegment*, size_t>> waiting{
        {m_kFile.root, 0}
    };
    while (!waiting.empty())
    {
        const auto [segment, depth] = waiting.back();
        waiting.pop_back();
        // A bone mesh nests one level deeper than its segment.
        if (depth >= kNestingLimit)
            return m_kRecord.Fail(EFailure::TooDeep, segment->line, segment->name);
        if (depth > 0)
            m_kFile.segmentOfName.emplace(segment->name, segment);
        for (auto child = segment->children.rbegin(); child != segment->children.rend(); ++child)
            waiting.emplace_back(*child, depth + 1);
    }
    return true;
}

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
    const auto found = m_kFile.segmentOfName.find(name);
    if (found == m_kFile.segmentOfName.end())
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
    const auto found = m_kFile.segmentOfName.find(name);
    if (found == m_kFile.segmentOfName.end())
        return Fail(EFailure::UnknownSegment, name);
    TKHTRSegment& segment = *found->second;
    const auto frames = static_cast<size_t>(std::max(m_kFile.numFrames, 0));
    const size_t rows = segment.scales.size() + std::min(frames, m_kLines.BytesLeft() / kBytesPerRow);
    segment.translations.reserve(rows);
    segment.rotations.reserve(rows);
    segment.scales.reserve(rows);

    float row[7] = {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 1.0f};
    for (std::string_view line; NextSectionLine(line);)
    {
        if (!ReadRow(segment, line, row))
            return false;
    }
    return true;
}

// The frame number is passed over: rows count in the order of the file. A short row leaves the others as they
// were in the row before.
bool CHTRReader::ReadRow(TKHTRSegment& segment, std::string_view line, std::span<float, 7> row)
{
    size_t count = 0;
    if (!SkipInteger(line))
        return Fail(EFailure::BadNumber, NextWord(line));
    if (!ReadNumbers(line, row, count))
        return false;
    if (count == 0)
        return Fail(EFailure::MissingTokens, segment.name);
    if (count < row.size())
        Warn(EFailure::ShortRow, segment.name);
    segment.translations.push_back({row[0], row[1], row[2]});
    segment.rotations.push_back({row[3], row[4], row[5]});
    segment.scales.push_back(row[6]);
    return true;
}

// As sscanf takes numbers: what is stuck to one begins the next. Commas separate like blanks.
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

bool CHTRReader::CheckFile()
{
    if (!m_kFile.root)
        return Fail(EFailure::MissingSection, "[SegmentNames&Hierarchy]");
    if (!m_kFile.FirstRoot())
        return Fail(EFailure::NoRoot, m_kFile.numSegments > 0 ? "GLOBAL" : "NumSegments");
    if (!KeyTimesFit(m_kFile.numFrames, m_kFile.segmentOfName.size(), m_kLines.ByteCount()))
        return m_kRecord.Fail(EFailure::BadCount, m_uiFramesLine, "NumFrames");
    WarnOfMissingRows();
    return true;
}

void CHTRReader::WarnOfMissingRows()
{
    for (const auto& segment : m_kFile.segments)
    {
        const auto found = m_kFile.segmentOfName.find(segment->name);
        const auto rows = static_cast<int64_t>(segment->scales.size());
        if (found != m_kFile.segmentOfName.end() && found->second == segment.get() &&
            rows < m_kFile.numFrames)
            m_kRecord.Warn(rows > 0 ? EFailure::TooFewRows : EFailure::MissingSection, segment->line,
                           segment->name);
    }
}

} // namespace gw
