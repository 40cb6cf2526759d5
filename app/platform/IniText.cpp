// Finds and changes values in the text of a settings file without rewriting the rest, so that comments and
// entries of other programs are preserved. A logical line can span several physical ones; Line describes its
// extent and what would close it.

#include "IniText.h"

#include "IniEscapes.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kNoSection = "General";

std::string_view Trimmed(std::string_view text)
{
    const size_t begin = text.find_first_not_of(kIniBlanks);
    if (begin == text.npos)
        return {};
    return text.substr(begin, text.find_last_not_of(kIniBlanks) + 1 - begin);
}

// A logical line of the dialect, which quotes and backslashes continue past line ends.
struct Line
{
    size_t m_uiBegin = 0; // offset in the whole text
    size_t m_uiEnd = 0;   // after the last character, without the line end
    size_t m_uiEquals = std::string_view::npos;
    std::string_view m_kClosing; // missing closing characters if the text ends inside it
};

// Returns the end of a comment, or of a line cut by ";".
size_t EndOfPhysicalLine(std::string_view text, size_t from)
{
    return std::min(text.find('\n', from), text.size());
}

// Finds the next line at or after an offset; false at the end of the text.
bool NextLineOf(std::string_view text, size_t from, Line& line)
{
    line = {};
    line.m_uiBegin = text.find_first_not_of(kIniBlanks, from);
    while (line.m_uiBegin != text.npos && text[line.m_uiBegin] == ';')
        line.m_uiBegin = text.find_first_not_of(kIniBlanks, EndOfPhysicalLine(text, line.m_uiBegin));
    if (line.m_uiBegin == text.npos)
        return false;
    bool quoted = false;
    size_t i = line.m_uiBegin;
    for (; i < text.size(); ++i)
    {
        const char c = text[i];
        if (c == '\\')
            ++i;
        else if (c == '"')
            quoted = !quoted;
        else if (!quoted && (c == '\n' || c == ';'))
            break;
        else if (!quoted && c == '=' && line.m_uiEquals == text.npos)
            line.m_uiEquals = i;
    }
    line.m_uiEnd = std::min(i, text.size());
    const bool isEscape = i > text.size(); // the last character was a backslash
    line.m_kClosing = isEscape ? (quoted ? "\n\"" : "\n") : (quoted ? "\"" : "");
    return true;
}

// Closes a last line left open by quotes or a backslash, which would otherwise swallow all appended text.
void CloseLastLine(std::string& text)
{
    std::string_view closing;
    for (Line line; NextLineOf(text, line.m_uiEnd, line);)
        closing = line.m_kClosing;
    text += closing;
}

// Returns the section that a header line opens; empty for the part without one.
std::string SectionOf(std::string_view line)
{
    const std::string_view inside = line.substr(1, line.find(']') - 1);
    const std::string_view name = Trimmed(inside);
    if (EqualNoCase(name, kNoSection))
        return {};
    return UnescapedIniKey(EqualNoCase(name, "%General") ? name.substr(1) : name);
}

// The position of a key, or where to insert it.
struct Place
{
    std::optional<Line> entry;
    std::optional<size_t> sectionEnd; // after the section's last line
};

Place FindPlace(std::string_view text, std::string_view section, std::string_view key)
{
    const std::string wanted = EqualNoCase(section, kNoSection) ? std::string() : std::string(section);
    Place place;
    std::string current;
    for (Line line; NextLineOf(text, line.m_uiEnd, line);)
    {
        const std::string_view content = text.substr(line.m_uiBegin, line.m_uiEnd - line.m_uiBegin);
        if (content.starts_with('['))
            current = SectionOf(content);
        if (current != wanted)
            continue;
        place.sectionEnd = line.m_uiEnd;
        const bool isEntry = !content.starts_with('[') && line.m_uiEquals != text.npos;
        if (isEntry &&
            UnescapedIniKey(Trimmed(text.substr(line.m_uiBegin, line.m_uiEquals - line.m_uiBegin))) == key)
            place.entry = line;
    }
    return place;
}

} // namespace

std::optional<std::string> FindIniValue(std::string_view text, std::string_view section, std::string_view key)
{
    text = SkipByteOrderMark(text);
    const auto entry = FindPlace(text, section, key).entry;
    if (!entry)
        return std::nullopt;
    const size_t begin = entry->m_uiEquals + 1;
    return UnescapedIniValue(Trimmed(text.substr(begin, entry->m_uiEnd - begin)));
}

std::string SetIniValue(std::string_view text, std::string_view section, std::string_view key,
                        std::string_view value)
{
    std::string result(SkipByteOrderMark(text));
    CloseLastLine(result);
    const Place place = FindPlace(result, section, key);
    const std::string entry = EscapedIniKey(key) + '=' + EscapedIniValue(value);
    if (place.entry)
        return result.replace(place.entry->m_uiBegin, place.entry->m_uiEnd - place.entry->m_uiBegin, entry);
    if (place.sectionEnd)
        return result.insert(EndOfPhysicalLine(result, *place.sectionEnd), '\n' + entry);
    if (!result.empty())
        result += result.ends_with('\n') ? "\n" : "\n\n";
    return result + '[' + EscapedIniKey(section) + "]\n" + entry + '\n';
}

} // namespace gw
