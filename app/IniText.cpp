#include "IniText.h"

#include "Text.h"
#include "Utf8.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <cstdio>

namespace gw {

namespace {

constexpr std::string_view kBlanks = " \t\r\n\v\f";
constexpr std::string_view kNoSection = "General";

std::string_view Trimmed(std::string_view text)
{
    const size_t begin = text.find_first_not_of(kBlanks);
    if (begin == text.npos)
        return {};
    return text.substr(begin, text.find_last_not_of(kBlanks) + 1 - begin);
}

// One line as the dialect sees it: quotes and backslashes carry it over line ends.
struct Line
{
    size_t m_uiBegin = 0; // in the whole text
    size_t m_uiEnd = 0;   // behind the last character, without the line end
    size_t m_uiEquals = std::string_view::npos;
};

// The end of a comment or of the line that a ";" cuts.
size_t EndOfPhysicalLine(std::string_view text, size_t from)
{
    return std::min(text.find('\n', from), text.size());
}

// Finds the next line from an offset on; false at the end of the text.
bool NextLineOf(std::string_view text, size_t from, Line& line)
{
    line = {};
    line.m_uiBegin = text.find_first_not_of(kBlanks, from);
    while (line.m_uiBegin != text.npos && text[line.m_uiBegin] == ';')
        line.m_uiBegin = text.find_first_not_of(kBlanks, EndOfPhysicalLine(text, line.m_uiBegin));
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
    return true;
}

// Reads digits of a base at a place; false, and the place left alone, where there are none.
bool TakeNumber(std::string_view text, size_t& place, size_t maxDigits, int base, uint32_t& number)
{
    const char* const begin = text.data() + place;
    const char* const end = begin + std::min(maxDigits, text.size() - place);
    const auto result = std::from_chars(begin, end, number, base);
    if (result.ec != std::errc())
        return false;
    place += static_cast<size_t>(result.ptr - begin);
    return true;
}

std::string UnescapedKey(std::string_view text)
{
    std::string key;
    for (size_t i = 0; i < text.size();)
    {
        const char c = text[i++];
        if (c != '%')
        {
            key += c == '\\' ? '/' : c;
            continue;
        }
        const bool isWide = text.substr(i, 1) == "U";
        const size_t digits = isWide ? 4 : 2;
        size_t place = i + (isWide ? 1 : 0);
        uint32_t point = 0;
        if (place + digits <= text.size() && TakeNumber(text, place, digits, 16, point))
            i = place;
        else
            point = '%';
        AppendUtf8(key, point);
    }
    return key;
}

std::string EscapedKey(std::string_view key)
{
    std::string text;
    for (const char c : key)
    {
        const bool isPlain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
                             c == '_' || c == '-' || c == '.';
        char escape[8];
        std::snprintf(escape, sizeof escape, "%%%02X", static_cast<unsigned char>(c));
        text += c == '/' ? "\\" : isPlain ? std::string(1, c) : escape;
    }
    return text;
}

constexpr struct
{
    char m_cLetter;
    char m_cMeaning;
} kEscapes[] = {
    {'a',  '\a'},
    {'b',  '\b'},
    {'f',  '\f'},
    {'n',  '\n'},
    {'r',  '\r'},
    {'t',  '\t'},
    {'v',  '\v'},
    {'"',  '"' },
    {'?',  '?' },
    {'\'', '\''},
    {'\\', '\\'},
};

// Reads the escape whose backslash stands before a place. An unknown letter is passed over, as is a line end.
void TakeEscape(std::string_view text, size_t& place, std::string& value)
{
    if (place == text.size())
        return;
    for (const auto& escape : kEscapes)
    {
        if (escape.m_cLetter == text[place])
        {
            value += escape.m_cMeaning;
            ++place;
            return;
        }
    }
    uint32_t point = 0;
    size_t digits = place + (text[place] == 'x' ? 1 : 0);
    if (TakeNumber(text, digits, text.npos, text[place] == 'x' ? 16 : 8, point))
    {
        AppendUtf8(value, point);
        place = digits;
        return;
    }
    place += text.substr(place).starts_with("\r\n") ? 2 : 1;
}

// "@" begins what is no plain text: "@@" stands for one, and bytes are taken as they are.
std::string WithoutMark(std::string value)
{
    constexpr std::string_view kBytes = "@ByteArray(";
    if (value.starts_with(kBytes) && value.ends_with(')'))
        return value.substr(kBytes.size(), value.size() - kBytes.size() - 1);
    if (value.starts_with("@@"))
        return value.substr(1);
    return value == "@Invalid()" ? std::string() : value;
}

std::string UnescapedValue(std::string_view text)
{
    std::string value;
    std::string element;
    size_t keep = 0; // blanks at the end of an element go, unless they stood in quotes
    bool quoted = false;
    const auto endElement = [&] {
        while (element.size() > keep && kBlanks.find(element.back()) != kBlanks.npos)
            element.pop_back();
        value += WithoutMark(std::move(element));
        element.clear();
        keep = 0;
    };
    for (size_t i = 0; i < text.size();)
    {
        const char c = text[i++];
        const bool isLeading = !quoted && element.empty() && kBlanks.find(c) != kBlanks.npos;
        if (c == '\\')
            TakeEscape(text, i, element);
        else if (c == '"')
            quoted = !quoted;
        else if (c == ',' && !quoted)
        {
            endElement();
            value += ',';
        }
        else if (!isLeading)
            element += c;
        if (quoted || c == '"' || c == '\\')
            keep = element.size();
    }
    endElement();
    return value;
}

std::string EscapedValue(std::string_view value)
{
    std::string text = value.starts_with('@') ? "@" : "";
    for (const char c : value)
    {
        if (c == '"' || c == '\\')
            text += '\\';
        if (c == '\n')
            text += "\\n";
        else if (c == '\r')
            text += "\\r";
        else if (c == '\t')
            text += "\\t";
        else
            text += c;
    }
    const bool hasEdgeBlank = value.starts_with(' ') || value.ends_with(' ');
    return hasEdgeBlank || value.find_first_of(";,=") != value.npos ? '"' + text + '"' : text;
}

// The section that a header line opens: empty for the part that has none.
std::string SectionOf(std::string_view line)
{
    const std::string_view inside = line.substr(1, line.find(']') - 1);
    const std::string_view name = Trimmed(inside);
    if (EqualNoCase(name, kNoSection))
        return {};
    return UnescapedKey(EqualNoCase(name, "%General") ? name.substr(1) : name);
}

// Where a key stands, and where a new one goes.
struct Place
{
    std::optional<Line> m_kEntry;
    std::optional<size_t> m_kSectionEnd; // behind the last line of the section
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
        place.m_kSectionEnd = line.m_uiEnd;
        const bool isEntry = !content.starts_with('[') && line.m_uiEquals != text.npos;
        if (isEntry &&
            UnescapedKey(Trimmed(text.substr(line.m_uiBegin, line.m_uiEquals - line.m_uiBegin))) == key)
            place.m_kEntry = line;
    }
    return place;
}

} // namespace

std::optional<std::string> FindIniValue(std::string_view text, std::string_view section, std::string_view key)
{
    text = SkipByteOrderMark(text);
    const auto entry = FindPlace(text, section, key).m_kEntry;
    if (!entry)
        return std::nullopt;
    const size_t begin = entry->m_uiEquals + 1;
    return UnescapedValue(Trimmed(text.substr(begin, entry->m_uiEnd - begin)));
}

std::string SetIniValue(std::string_view text, std::string_view section, std::string_view key,
                        std::string_view value)
{
    text = SkipByteOrderMark(text);
    const Place place = FindPlace(text, section, key);
    const std::string entry = EscapedKey(key) + '=' + EscapedValue(value);
    std::string result(text);
    if (place.m_kEntry)
        return result.replace(place.m_kEntry->m_uiBegin, place.m_kEntry->m_uiEnd - place.m_kEntry->m_uiBegin,
                              entry);
    if (place.m_kSectionEnd)
        return result.insert(EndOfPhysicalLine(text, *place.m_kSectionEnd), '\n' + entry);
    if (!result.empty())
        result += result.ends_with('\n') ? "\n" : "\n\n";
    return result + '[' + EscapedKey(section) + "]\n" + entry + '\n';
}

} // namespace gw
