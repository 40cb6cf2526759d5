// Escapes names for pages and scripts. The pages are in Big5, where the second byte of a character can look
// like ASCII markup, so everything outside printable ASCII is written as an escape.

#include "HTMLText.h"

#include "CodePoints.h"
#include "Numbers.h"

#include <algorithm>
#include <cfloat>
#include <cstdint>
#include <cstdio>
#include <span>

namespace gw {

namespace {

struct EscapeRow
{
    char character;
    std::string_view text;
};

constexpr EscapeRow kPageEscapes[] = {
    {'&', "&amp;" },
    {'<', "&lt;"  },
    {'>', "&gt;"  },
    {'"', "&quot;"},
};

void AppendToPage(std::string& out, char character)
{
    for (const EscapeRow& row : kPageEscapes)
    {
        if (row.character != character)
            continue;
        out += row.text;
        return;
    }
    out += character;
}

// Browsers read a page's bytes as Big5, where the second byte of a character can be a backslash, a letter or
// a brace. After a byte above 7F, an escape would not be recognized and a quote would end the text. So
// scripts contain no such bytes, and no "<" either, because a script element's end is searched even inside
// texts.
bool IsPlainInScript(char32_t point)
{
    return point >= U' ' && point <= U'~' && point != U'"' && point != U'\\' && point != U'<';
}

void AppendToScript(std::string& out, char32_t point)
{
    char escape[16];
    if (IsPlainInScript(point))
        out += static_cast<char>(point);
    else
        out.append(escape, static_cast<size_t>(std::snprintf(escape, sizeof escape,
                                                             point < 0x100 ? "\\x%02x" : "\\u{%x}",
                                                             static_cast<unsigned>(point))));
}

std::string InBrackets(std::span<const float> values)
{
    std::string text = "(";
    for (const float& value : values)
    {
        if (&value != values.data())
            text += ", ";
        AppendFixed3(text, value);
    }
    return text + ')';
}

} // namespace

std::string HTMLText(std::string_view name)
{
    std::string out;
    if (const auto points = CodePoints(name, EEncoding::UTF8))
    {
        for (const char32_t point : *points)
        {
            if (point > U'~')
                out += "&#" + std::to_string(static_cast<uint32_t>(point)) + ';';
            else
                AppendToPage(out, static_cast<char>(point));
        }
        return out;
    }
    for (const char byte : name)
        AppendToPage(out, byte);
    return out;
}

std::string HTMLScriptText(std::string_view name)
{
    std::string out;
    for (const EEncoding encoding : {EEncoding::UTF8, EEncoding::Big5})
    {
        const auto points = CodePoints(name, encoding);
        for (const char32_t point : points.value_or(U""))
            AppendToScript(out, point);
        if (points)
            return out;
    }
    for (const char byte : name)
        AppendToScript(out, static_cast<uint8_t>(byte));
    return out;
}

std::string HTMLText(float value)
{
    if (value >= FLT_MAX)
        return "INFINITY";
    if (value <= -FLT_MAX)
        return "-INFINITY";
    std::string text;
    AppendFixed3(text, value);
    return text;
}

std::string HTMLText(const Vec3& v)
{
    const float values[] = {v.x, v.y, v.z};
    return InBrackets(values);
}

std::string HTMLText(const Quat& q)
{
    const float values[] = {q.w, q.x, q.y, q.z};
    return InBrackets(values);
}

std::string HTMLText(const Mat4& m)
{
    std::string text = "[";
    const std::span<const float> values(m.m);
    for (size_t row = 0; row < 4; ++row)
        text.append(row == 0 ? "" : ",").append(InBrackets(values.subspan(4 * row, 4)));
    return text + ']';
}

} // namespace gw
