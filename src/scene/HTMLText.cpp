#include "HTMLText.h"

#include "Numbers.h"

#include <cfloat>
#include <charconv>
#include <cstdint>
#include <iterator>
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

// No "<" either: a script element looks for its end in texts too.
constexpr EscapeRow kScriptEscapes[] = {
    {'\\', "\\\\" },
    {'"',  "\\\"" },
    {'<',  "\\x3c"},
    {'\n', "\\n"  },
    {'\r', "\\r"  },
};

// Where a name goes: what its characters become there.
struct Place
{
    std::span<const EscapeRow> escapes;
    std::string_view pointBegin; // around a code point in decimal or hexadecimal digits
    std::string_view pointEnd;
    int base;
};

constexpr Place kInPage{kPageEscapes, "&#", ";", 10};
constexpr Place kInScript{kScriptEscapes, "\\u{", "}", 16};

// A form of two to four bytes: its first byte, and the least point that may take it.
struct Utf8Row
{
    uint8_t mask;
    uint8_t mark;
    size_t length;
    uint32_t least;
};

constexpr Utf8Row kUtf8[] = {
    {0xe0, 0xc0, 2, 0x80   },
    {0xf0, 0xe0, 3, 0x800  },
    {0xf8, 0xf0, 4, 0x10000},
};

uint8_t ByteAt(std::string_view text, size_t index)
{
    return static_cast<uint8_t>(text[index]);
}

bool IsPoint(uint32_t point)
{
    return point <= 0x10ffff && (point < 0xd800 || point > 0xdfff);
}

// Takes a character that is no ASCII off the front; 0 where there is none.
uint32_t TakePoint(std::string_view& rest)
{
    for (const Utf8Row& row : kUtf8)
    {
        if ((ByteAt(rest, 0) & row.mask) != row.mark || rest.size() < row.length)
            continue;
        uint32_t point = ByteAt(rest, 0) & static_cast<uint8_t>(~row.mask);
        for (size_t i = 1; i < row.length; ++i)
        {
            if ((ByteAt(rest, i) & 0xc0) != 0x80)
                return 0;
            point = point << 6 | (ByteAt(rest, i) & 0x3f);
        }
        rest.remove_prefix(row.length);
        return point >= row.least && IsPoint(point) ? point : 0;
    }
    return 0;
}

bool IsASCII(std::string_view rest)
{
    return ByteAt(rest, 0) < 0x80;
}

bool IsUtf8(std::string_view text)
{
    while (!text.empty())
    {
        if (IsASCII(text))
            text.remove_prefix(1);
        else if (TakePoint(text) == 0)
            return false;
    }
    return true;
}

// The second byte of a Big5 character may be a backslash, which then is none. After the other first bytes a
// browser takes it for itself.
bool IsBig5WithBackslash(std::string_view rest)
{
    return rest.size() > 1 && rest[1] == '\\' && ByteAt(rest, 0) >= 0xa1 && ByteAt(rest, 0) <= 0xf9 &&
           ByteAt(rest, 0) != 0xc8;
}

std::string_view Escaped(const Place& place, const char& character)
{
    for (const EscapeRow& row : place.escapes)
    {
        if (row.character == character)
            return row.text;
    }
    return {&character, 1};
}

void AppendPoint(std::string& out, const Place& place, uint32_t point)
{
    char digits[16];
    char* const end = std::to_chars(digits, std::end(digits), point, place.base).ptr;
    out.append(place.pointBegin).append(std::begin(digits), end).append(place.pointEnd);
}

std::string Shown(std::string_view name, const Place& place)
{
    std::string out;
    const bool isUtf8 = IsUtf8(name);
    while (!name.empty())
    {
        if (!IsASCII(name) && isUtf8)
        {
            AppendPoint(out, place, TakePoint(name));
            continue;
        }
        const size_t taken = IsBig5WithBackslash(name) ? 2 : 1;
        out += taken == 2 ? name.substr(0, 2) : Escaped(place, name.front());
        name.remove_prefix(taken);
    }
    return out;
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
    return Shown(name, kInPage);
}

std::string HTMLScriptText(std::string_view name)
{
    return Shown(name, kInScript);
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
