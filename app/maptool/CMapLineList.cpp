// The list of map lines. Lines keep their text; only lines that the tool edits are rewritten.

#include "CMapLineList.h"

#include "ProfileNames.h"
#include "Text.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace gw {

namespace {

constexpr std::string_view kPosition = "position";
constexpr std::string_view kFrameRate = "framerate";
constexpr std::string_view kHeadText = "Unknown Source";
constexpr size_t kTextLimit = 32;

bool SpeaksOfPosition(const MapLine& line)
{
    return LowerCase(line.text).find(kPosition) != std::string::npos;
}

// A keyword further inside, as in "Composition", makes a line of its kind but sets nothing.
bool BeginsWith(const MapLine& line, std::string_view keyword)
{
    return EqualNoCase(std::string_view(line.text).substr(0, keyword.size()), keyword);
}

std::string RewrittenText(const MapLine& line)
{
    switch (line.kind)
    {
    case EMapLine::Mapping:
        return MappingLine(line.source, line.target, line.numbers);
    case EMapLine::Position:
        return PositionLine(line.numbers);
    case EMapLine::FrameRate:
        return FrameRateLine(line.frameRate);
    case EMapLine::Fixed:
    case EMapLine::Text:
        break;
    }
    return std::string(FirstCharacters(line.text, kTextLimit));
}

} // namespace

const MapLine* CMapLineList::SelectedLine() const
{
    return m_iSelected == kNone ? nullptr : &m_kLines[static_cast<size_t>(m_iSelected)];
}

void CMapLineList::Select(int index)
{
    m_iSelected = index >= 0 && static_cast<size_t>(index) < m_kLines.size() ? index : kNone;
}

void CMapLineList::Append(const MapLine& line)
{
    TakeValue(line);
    m_kLines.push_back(line);
}

void CMapLineList::EnsureHead()
{
    if (std::ranges::any_of(m_kLines, SpeaksOfPosition))
        return;
    const MapLine head[] = {ParseMapLine(kHeadText), ParseMapLine(PositionLine(kVec3Zero)),
                            ParseMapLine(FrameRateLine(kDefaultFrameRate))};
    std::ranges::for_each(head, [this](const MapLine& line) { TakeValue(line); });
    m_kLines.insert(m_kLines.begin(), std::begin(head), std::end(head));
    if (m_iSelected != kNone)
        m_iSelected += static_cast<int>(std::size(head));
}

void CMapLineList::Add(std::string_view source, std::string_view target)
{
    EnsureHead();
    Append(ParseMapLine(MappingLine(source, target)));
}

size_t CMapLineList::Replace(const std::vector<MapLine>& lines, const Fits& fits)
{
    Clear();
    size_t leftOut = 0;
    for (const MapLine& line : lines)
    {
        if (line.kind == EMapLine::Mapping && !fits(line))
        {
            ++leftOut;
            continue;
        }
        if (line.kind == EMapLine::Mapping)
            EnsureHead();
        Append(line);
    }
    return leftOut;
}

size_t CMapLineList::Prune(const Fits& fits)
{
    const std::vector<MapLine> before = std::exchange(m_kLines, {});
    const int selected = std::exchange(m_iSelected, kNone);
    for (size_t index = 0; index < before.size(); ++index)
    {
        const MapLine& line = before[index];
        if (line.kind != EMapLine::Mapping || !fits(line))
            continue;
        if (static_cast<int>(index) == selected)
            m_iSelected = static_cast<int>(m_kLines.size());
        m_kLines.push_back(line);
    }
    return before.size() - m_kLines.size();
}

// Selects the line that moves up, so that repeated clicks remove a run of lines.
void CMapLineList::RemoveSelected()
{
    if (m_iSelected == kNone)
        return;
    m_kLines.erase(m_kLines.begin() + m_iSelected);
    Select(std::min(m_iSelected, static_cast<int>(m_kLines.size()) - 1));
}

void CMapLineList::Clear()
{
    m_kLines.clear();
    m_iSelected = kNone;
}

void CMapLineList::ReplaceSelected(const MapLine& line)
{
    if (m_iSelected == kNone)
        return;
    TakeValue(line);
    m_kLines[static_cast<size_t>(m_iSelected)] = line;
}

void CMapLineList::TakeValue(const MapLine& line)
{
    if (line.kind == EMapLine::Position && BeginsWith(line, kPosition))
        m_kRootPosition = line.numbers;
    if (line.kind == EMapLine::FrameRate && BeginsWith(line, kFrameRate))
        m_iFrameRate = line.frameRate;
}

MapLine RewrittenLine(const MapLine& line)
{
    return ParseMapLine(RewrittenText(line));
}

} // namespace gw
