#include "CMarkup.h"

#include "Numbers.h"
#include "Paths.h"
#include "Text.h"

#include <cstddef>

namespace gw {

namespace {

constexpr size_t kLongestName = 300; // file systems limit names to 255 bytes

std::string_view EscapeOf(char c)
{
    switch (c)
    {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '"':
        return "&quot;";
    case '\'':
        return "&#39;";
    default:
        return {};
    }
}

} // namespace

CMarkup& CMarkup::Name(std::string_view name)
{
    // If cutting splits a character, its bytes are shown as \xNN.
    for (const char c : Printable(name.substr(0, kLongestName)))
    {
        const std::string_view escape = EscapeOf(c);
        if (escape.empty())
            m_kText += c;
        else
            m_kText += escape;
    }
    return name.size() > kLongestName ? Raw("…") : *this;
}

CMarkup& CMarkup::Link(std::string_view path)
{
    constexpr std::string_view kPlain = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789-_./";
    constexpr const char* kDigits = "0123456789ABCDEF";
    for (const char c : path)
    {
        const auto byte = static_cast<unsigned char>(c);
        if (kPlain.find(c) != kPlain.npos)
            m_kText += c;
        else
            Raw("%").Raw({&kDigits[byte >> 4], 1}).Raw({&kDigits[byte & 15], 1});
    }
    return *this;
}

CMarkup& CMarkup::FileName(std::string_view path)
{
    const PathParts parts = SplitPath(path);
    return Raw("<span title=\"").Name(path).Raw("\">").Name(parts.stem + parts.extension).Raw("</span>");
}

CMarkup& CMarkup::JsonText(std::string_view text)
{
    m_kText += '"';
    for (const char c : Printable(text.substr(0, kLongestName)))
    {
        constexpr const char* kDigits = "0123456789abcdef";
        if (c == '"' || c == '\\' || !EscapeOf(c).empty())
            Raw("\\u00").Raw({&kDigits[c >> 4], 1}).Raw({&kDigits[c & 15], 1});
        else
            m_kText += c;
    }
    m_kText += '"';
    return *this;
}

CMarkup& CMarkup::Base64(std::string_view bytes)
{
    constexpr const char* kDigits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    for (size_t i = 0; i < bytes.size(); i += 3)
    {
        const auto byte = [&](size_t at) {
            return at < bytes.size() ? static_cast<unsigned>(static_cast<unsigned char>(bytes[at])) : 0u;
        };
        const unsigned bits = byte(i) << 16 | byte(i + 1) << 8 | byte(i + 2);
        m_kText += kDigits[bits >> 18];
        m_kText += kDigits[bits >> 12 & 63];
        m_kText += i + 1 < bytes.size() ? kDigits[bits >> 6 & 63] : '=';
        m_kText += i + 2 < bytes.size() ? kDigits[bits & 63] : '=';
    }
    return *this;
}

CMarkup& CMarkup::Number(double value, int decimals)
{
    AppendFixed(m_kText, value, decimals);
    return *this;
}

CMarkup& CMarkup::Integer(long long value)
{
    m_kText += std::to_string(value);
    return *this;
}

} // namespace gw
