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

CMarkup& CMarkup::FileName(std::string_view path)
{
    const PathParts parts = SplitPath(path);
    return Raw("<span title=\"").Name(path).Raw("\">").Name(parts.stem + parts.extension).Raw("</span>");
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
