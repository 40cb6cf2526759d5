// Parses and writes the older map syntax. Any text is a valid line, so parsing cannot fail.

#include "MapLines.h"

#include "CSafeFile.h"
#include "Numbers.h"
#include "ProfileFile.h"
#include "SystemConventions.h"
#include "Text.h"

namespace gw {

namespace {

constexpr std::string_view kArrow = "<--->";
constexpr std::string_view kPosition = "position";
constexpr std::string_view kFrameRate = "framerate";

// Parses three numbers separated by commas or blanks; missing ones are 0.
Vec3 ParseThree(std::string_view text)
{
    const auto next = [&text] { return static_cast<float>(ParseDouble(NextToken(text))); };
    return {next(), next(), next()};
}

void ParseMapping(std::string_view text, MapLine& line)
{
    line.source = NextWord(text);
    NextWord(text); // skip the arrow
    line.target = NextWord(text);
    const size_t begin = text.find_first_not_of(kTokenDelimiters);
    // A dot means that no rotation was set.
    line.hasRotation = begin != text.npos && text[begin] != '.';
    if (line.hasRotation)
        line.numbers = ParseThree(text);
}

std::string ThreeText(const Vec3& numbers)
{
    const auto cut = [](float value) { return std::to_string(CutToInteger(value)); };
    return cut(numbers.x) + ',' + cut(numbers.y) + ',' + cut(numbers.z);
}

} // namespace

MapLine ParseMapLine(std::string_view text)
{
    MapLine line;
    line.text = text;
    const std::string lower = LowerCase(text);
    // Returns the text after a keyword, wherever it is in the line.
    const auto behind = [&](std::string_view keyword) {
        const size_t found = lower.find(keyword);
        return found == lower.npos ? std::string_view() : text.substr(found + keyword.size());
    };
    if (lower.find(kArrow) != lower.npos)
    {
        line.kind = EMapLine::Mapping;
        ParseMapping(text, line);
    }
    else if (lower.find('*') != lower.npos)
    {
        line.kind = EMapLine::Fixed;
        NextWord(text);
        line.target = NextWord(text);
    }
    else if (lower.find(kPosition) != lower.npos)
    {
        line.kind = EMapLine::Position;
        line.numbers = ParseThree(behind(kPosition));
    }
    else if (lower.find(kFrameRate) != lower.npos)
    {
        line.kind = EMapLine::FrameRate;
        std::string_view rest = behind(kFrameRate);
        line.frameRate = ParseInt(NextToken(rest));
    }
    return line;
}

std::string PositionLine(const Vec3& position)
{
    return "Position " + ThreeText(position);
}

std::string FrameRateLine(int frameRate)
{
    return "FrameRate " + std::to_string(frameRate);
}

std::string MappingLine(std::string_view source, std::string_view target)
{
    return std::string(source).append(" <---> ").append(target).append(" .");
}

std::string MappingLine(std::string_view source, std::string_view target, const Vec3& degrees)
{
    return std::string(source).append(" <---> ").append(target).append(" ").append(ThreeText(degrees));
}

bool ReadMapLines(const std::string& path, std::vector<MapLine>& lines)
{
    std::string text;
    if (!ReadProfileText(path, text))
        return false;
    lines.clear();
    std::string_view rest = SkipByteOrderMark(text);
    std::string_view line;
    while (NextLine(rest, line))
        lines.push_back(ParseMapLine(line));
    return true;
}

bool WriteMapLines(const std::string& path, std::span<const MapLine> lines)
{
    std::string text;
    for (const MapLine& line : lines)
        text.append(line.text).append(kLineEnd);
    // If the first line starts with a byte order mark, readers would drop it.
    if (SkipByteOrderMark(text).size() < text.size())
        text.insert(0, text.substr(0, text.size() - SkipByteOrderMark(text).size()));
    CSafeFile file;
    return file.Open(path) && file.Write(text) && file.Commit();
}

} // namespace gw
