#include "CHTRReader.h"

#include "CGraphCheck.h"
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

constexpr std::string_view kEndSection = "[EndOfFile]"; // closes files of other programs

bool TakeValue(std::string_view token, TKHTRFile& file, const CHTRText& field)
{
    file.*field.text = token.substr(0, field.size - 1);
    return true;
}

bool TakeValue(std::string_view token, TKHTRFile& file, char TKHTRFile::*field)
{
    file.*field = token[0];
    return true;
}

bool TakeValue(std::string_view token, TKHTRFile& file, int TKHTRFile::*field)
{
    return ScanInt(token, file.*field);
}

bool TakeValue(std::string_view token, TKHTRFile& file, float TKHTRFile::*field)
{
    return ScanFloat(token, file.*field) && std::isfinite(file.*field);
}

} // namespace

const CHTRReader::HandlerRow CHTRReader::kHandlers[] = {
    {"[Header]",                 &CHTRReader::ReadHeader      },
    {"[SegmentNames&Hierarchy]", &CHTRReader::ReadHierarchy   },
    {"[BasePosition]",           &CHTRReader::ReadBasePosition},
};

bool CHTRReader::Fail(EFailure reason, std::string_view name)
{
    return m_kRecord.Fail(reason, m_kLines.LineNumber(), Quote(name));
}

void CHTRReader::Warn(EFailure reason, std::string_view name)
{
    m_kRecord.Warn(reason, m_kLines.LineNumber(), Quote(name));
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

// A key without a value is as good as a missing one: its field keeps the default.
bool CHTRReader::ReadKey(std::string_view key, std::string_view rest)
{
    const auto known = std::ranges::find(kHTRKeys, key, &CHTRKey::name);
    if (known == std::end(kHTRKeys))
        return true;
    const std::string_view token = NextToken(rest);
    if (token.empty())
    {
        Warn(EFailure::MissingTokens, key);
        return true;
    }
    if (key == "NumFrames")
        m_uiFramesLine = m_kLines.LineNumber();
    const auto take = [&](const auto& field) { return TakeValue(token, m_kFile, field); };
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
    if (!MayBeName(name) || !MayBeName(parentName))
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
        const auto rows = static_cast<int64_t>(segment->scales.size());
        if (rows >= m_kFile.numFrames || !m_kFile.segmentOfName.contains(segment->name))
            continue;
        const EFailure reason = rows > 0 ? EFailure::TooFewRows : EFailure::MissingSection;
        m_kRecord.Warn(reason, segment->line, segment->name);
    }
}

} // namespace gw
