// The escapes of the INI dialect, as Qt reads and writes them: %XX in keys, backslashes and quotes in values.
// Reading accepts whatever Qt accepts, since people edit these files by hand.

#include "IniEscapes.h"

#include "Utf8.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <cstdio>

namespace gw {

namespace {

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

// Reads digits in a base at a position; returns false and leaves the position unchanged if there are none.
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

// Reads the escape after a backslash. An unknown letter or a line end is skipped.
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

// "@" starts a value that is not plain text: "@@" is a literal "@", and bytes are used unchanged.
std::string WithoutMark(const std::string& value)
{
    constexpr std::string_view kBytes = "@ByteArray(";
    if (value.starts_with(kBytes) && value.ends_with(')'))
        return value.substr(kBytes.size(), value.size() - kBytes.size() - 1);
    if (value.starts_with("@@"))
        return value.substr(1);
    return value == "@Invalid()" ? std::string() : value;
}

} // namespace

std::string UnescapedIniKey(std::string_view text)
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

std::string EscapedIniKey(std::string_view key)
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

std::string UnescapedIniValue(std::string_view text)
{
    std::string value;
    std::string element;
    size_t keep = 0; // blanks at the end of an element are removed, unless quoted
    bool quoted = false;
    const auto endElement = [&] {
        while (element.size() > keep && kIniBlanks.find(element.back()) != kIniBlanks.npos)
            element.pop_back();
        value += WithoutMark(element);
        element.clear();
        keep = 0;
    };
    for (size_t i = 0; i < text.size();)
    {
        const char c = text[i++];
        const bool isLeading = !quoted && element.empty() && kIniBlanks.find(c) != kIniBlanks.npos;
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

std::string EscapedIniValue(std::string_view value)
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

} // namespace gw
