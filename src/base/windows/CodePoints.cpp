#include "CodePoints.h"

#include "WindowsCalls.h"

#include <algorithm>

namespace gw {

namespace {

constexpr UINT kBig5 = 950;

bool IsPrivateUse(char32_t point)
{
    return point >= 0xe000 && point <= 0xf8ff;
}

} // namespace

std::optional<std::u32string> CodePoints(std::string_view text, EEncoding encoding)
{
    const UINT page = encoding == EEncoding::UTF8 ? CP_UTF8 : kBig5;
    const int length = static_cast<int>(text.size());
    std::wstring wide(text.size(), L'\0'); // no encoding has more characters than bytes
    const int size =
        MultiByteToWideChar(page, MB_ERR_INVALID_CHARS, text.data(), length, wide.data(), length);
    if (size == 0 && length > 0)
        return std::nullopt;
    std::u32string points;
    for (size_t i = 0; i < static_cast<size_t>(size); ++i)
    {
        char32_t point = wide[i];
        if (IS_HIGH_SURROGATE(point) && i + 1 < static_cast<size_t>(size))
            point = 0x10000 + ((point - 0xd800) << 10) + (wide[++i] - char32_t{0xdc00});
        points.push_back(point);
    }
    // The system has these for bytes of Big5 that stand for no character.
    if (encoding == EEncoding::Big5 && std::ranges::any_of(points, IsPrivateUse))
        return std::nullopt;
    return points;
}

} // namespace gw
