// Escapes names for pages and scripts. The pages are in Big5, where the second byte of a character can look
// like ASCII markup, so everything outside printable ASCII is written as an escape.

#include "HTMLText.h"

#include "Numbers.h"

#include <algorithm>
#include <cfloat>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <span>

#include <iconv.h>

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

// Decodes a name in a character set of the C library; nothing if its bytes are not valid in it.
std::optional<std::u32string> CodePoints(std::string_view name, const char* characterSet)
{
    constexpr size_t kPointsPerByte = 2; // at most, in Big5: a letter with its accent
    constexpr char32_t kLastPoint = 0x10ffff;
    const iconv_t converter = iconv_open("UCS-4LE", characterSet);
    if (converter == reinterpret_cast<iconv_t>(-1))
        return std::nullopt;
    std::u32string points(kPointsPerByte * name.size(), U'\0');
    char* from = const_cast<char*>(name.data()); // the interface predates const
    char* to = reinterpret_cast<char*>(points.data());
    size_t fromBytes = name.size();
    size_t toBytes = points.size() * sizeof(char32_t);
    const bool isWhole = iconv(converter, &from, &fromBytes, &to, &toBytes) != static_cast<size_t>(-1) &&
                         iconv(converter, nullptr, nullptr, &to, &toBytes) != static_cast<size_t>(-1);
    iconv_close(converter);
    points.resize(points.size() - toBytes / sizeof(char32_t));
    if (!isWhole || std::ranges::any_of(points, [](char32_t point) { return point > kLastPoint; }))
        return std::nullopt;
    return points;
}

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
    if (const auto points = CodePoints(name, "UTF-8"))
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
    for (const char* characterSet : {"UTF-8", "BIG5-HKSCS"})
    {
        const auto points = CodePoints(name, characterSet);
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
