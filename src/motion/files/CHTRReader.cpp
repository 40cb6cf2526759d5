// Reads HTR files. A file has a header, a hierarchy of names, a base pose, and one section of rows per
// segment. Sections are found by name through a table of functions. Files name segments twice, in cycles or
// not at all; such segments are left out with a warning instead of failing the file.

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

constexpr std::string_view kEndSection = "[EndOfFile]"; // ends files of other programs

bool TakeValue(std::string_view token, TKHTRFile& file, const HTRText& field)
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
    return record_.Fail(reason, lines_.LineNumber(), Quote(name));
}

void CHTRReader::Warn(EFailure reason, std::string_view name)
{
    record_.Warn(reason, lines_.LineNumber(), Quote(name));
}

bool CHTRReader::Read()
{
    for (std::string_view line; lines_.Next(line);)
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

// Reads the next line that is neither empty nor a comment. At the start of a section, returns false with the
// cursor before it.
bool CHTRReader::NextSectionLine(std::string_view& line)
{
    while (lines_.Next(line))
    {
        if (line.starts_with('['))
        {
            lines_.StepBack();
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
    for (std::string_view rest; lines_.Next(rest);)
    {
        const std::string_view key = NextToken(rest);
        if (key.starts_with('['))
        {
            lines_.StepBack();
            return true;
        }
        if (!ReadKey(key, rest))
            return false;
    }
    return true;
}

// A key without a value keeps its default, like a missing key.
bool CHTRReader::ReadKey(std::string_view key, std::string_view rest)
{
    const auto known = std::ranges::find(kHTRKeys, key, &HTRKey::name);
    if (known == std::end(kHTRKeys))
        return true;
    const std::string_view token = NextToken(rest);
    if (token.empty())
    {
        Warn(EFailure::MissingTokens, key);
        return true;
    }
    if (key == "NumFrames")
        m_uiFramesLine = lines_.LineNumber();
    const auto take = [&](const auto& field) { return TakeValue(token, file_, field); };
    return std::visit(take, known->field) || Fail(EFailure::BadNumber, token);
}

bool CHTRReader::ReadHierarchy(std::string_view)
{
    file_.segmentOfName.clear();
    file_.segments.clear();
    file_.root = file_.segments.emplace_back(std::make_unique<TKHTRSegment>()).get();
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
    if (file_.segments.size() > kBoneLimit)
        return Fail(EFailure::TooLarge, name);
    auto segment = std::make_unique<TKHTRSegment>();
    segment->name = name;
    segment->parentName = parentName;
    segment->line = lines_.LineNumber();
    file_.segments.push_back(std::move(segment));
    return true;
}

// Attaches the segments to their parents, as many as the header counts. Of two equal names, the first is
// used. Segments that form a cycle are attached to nothing and never reached.
void CHTRReader::LinkSegments()
{
    std::unordered_map<std::string_view, TKHTRSegment*> segmentOfName{
        {"GLOBAL", file_.root}
    };
    for (size_t i = 1; i < file_.segments.size(); ++i)
        segmentOfName.emplace(file_.segments[i]->name, file_.segments[i].get());
    const size_t listed = file_.segments.size() - 1;
    const size_t counted = std::min(static_cast<size_t>(std::max(file_.numSegments, 0)), listed);
    for (size_t i = 1; i <= counted; ++i)
    {
        TKHTRSegment& segment = *file_.segments[i];
        const auto parent = segmentOfName.find(segment.parentName);
        if (parent == segmentOfName.end())
        {
            record_.Warn(EFailure::UnknownSegment, segment.line, segment.parentName);
            continue;
        }
        parent->second->children.push_back(&segment);
        m_kSegmentSections.insert("[" + segment.name + "]");
    }
    if (counted < listed)
        record_.Warn(EFailure::BadCount, file_.segments[counted + 1]->line, "NumSegments");
}

// Depth first, so a name refers to the same segment as a search from the root.
bool CHTRReader::IndexSegments()
{
    std::vector<std::pair<TKHTRSegment*, size_t>> waiting{
        {file_.root, 0}
    };
    while (!waiting.empty())
    {
        const auto [segment, depth] = waiting.back();
        waiting.pop_back();
        // A bone mesh is nested one level deeper than its segment.
        if (depth >= kNestingLimit)
            return record_.Fail(EFailure::TooDeep, segment->line, segment->name);
        if (depth > 0)
            file_.segmentOfName.emplace(segment->name, segment);
        for (auto child = segment->children.rbegin(); child != segment->children.rend(); ++child)
            waiting.emplace_back(*child, depth + 1);
    }
    return true;
}

bool CHTRReader::CheckFile()
{
    if (!file_.root)
        return Fail(EFailure::MissingSection, "[SegmentNames&Hierarchy]");
    if (!file_.FirstRoot())
        return Fail(EFailure::NoRoot, file_.numSegments > 0 ? "GLOBAL" : "NumSegments");
    if (!KeyTimesFit(file_.numFrames, file_.segmentOfName.size(), lines_.ByteCount()))
        return record_.Fail(EFailure::BadCount, m_uiFramesLine, "NumFrames");
    WarnOfMissingRows();
    return true;
}

void CHTRReader::WarnOfMissingRows()
{
    for (const auto& segment : file_.segments)
    {
        const auto rows = static_cast<int64_t>(segment->scales.size());
        if (rows >= file_.numFrames || !file_.segmentOfName.contains(segment->name))
            continue;
        const EFailure reason = rows > 0 ? EFailure::TooFewRows : EFailure::MissingSection;
        record_.Warn(reason, segment->line, segment->name);
    }
}

} // namespace gw
