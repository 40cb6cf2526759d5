#include "CodePoints.h"

#include <algorithm>

#include <iconv.h>

namespace gw {

std::optional<std::u32string> CodePoints(std::string_view text, EEncoding encoding)
{
    constexpr size_t kPointsPerByte = 2; // at most, in Big5: a letter with its accent
    constexpr char32_t kLastPoint = 0x10ffff;
    const iconv_t converter = iconv_open("UCS-4LE", encoding == EEncoding::UTF8 ? "UTF-8" : "BIG5-HKSCS");
    // NOLINTNEXTLINE(performance-no-int-to-ptr): that is how the interface reports a failure
    if (converter == reinterpret_cast<iconv_t>(-1))
        return std::nullopt;
    std::u32string points(kPointsPerByte * text.size(), U'\0');
    char* from = const_cast<char*>(text.data()); // the interface predates const
    char* to = reinterpret_cast<char*>(points.data());
    size_t fromBytes = text.size();
    size_t toBytes = points.size() * sizeof(char32_t);
    const bool isWhole = iconv(converter, &from, &fromBytes, &to, &toBytes) != static_cast<size_t>(-1) &&
                         iconv(converter, nullptr, nullptr, &to, &toBytes) != static_cast<size_t>(-1);
    iconv_close(converter);
    points.resize(points.size() - toBytes / sizeof(char32_t));
    if (!isWhole || std::ranges::any_of(points, [](char32_t point) { return point > kLastPoint; }))
        return std::nullopt;
    return points;
}

} // namespace gw
