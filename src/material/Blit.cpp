// Draws part of a picture onto another. Both rectangles are clipped in 64 bits, one dimension at a time; then
// each row is drawn by a function chosen by the two pixel formats.

#include "Blit.h"

#include <algorithm>
#include <cstring>

namespace gw {

namespace {

constexpr int32_t kBlitFormats = 2;

// Bytes per pixel of the drawable formats.
constexpr int32_t kBGRA = 4;
constexpr int32_t kBGR = 3;

uint8_t Mix(uint32_t to, uint32_t from, uint32_t opacity)
{
    return static_cast<uint8_t>((to * (kOpaque - opacity) + from * opacity + kOpaque / 2) / kOpaque);
}

template <int32_t kTo, int32_t kFrom>
void CopyRow(uint8_t* to, const uint8_t* from, int32_t count)
{
    if constexpr (kTo == kFrom)
    {
        std::memcpy(to, from, static_cast<size_t>(count) * kTo);
        return;
    }
    for (; count > 0; --count, to += kTo, from += kFrom)
    {
        std::memcpy(to, from, kBGR);
        if constexpr (kTo == kBGRA)
            to[kBGR] = kOpaque;
    }
}

template <int32_t kTo, int32_t kFrom>
void DrawRow(uint8_t* to, const uint8_t* from, int32_t count, uint32_t opacity)
{
    if (opacity == kOpaque)
        return CopyRow<kTo, kFrom>(to, from, count);
    for (; count > 0; --count, to += kTo, from += kFrom)
    {
        for (int32_t i = 0; i < kBGR; ++i)
            to[i] = Mix(to[i], from[i], opacity);
        if constexpr (kTo == kBGRA)
            to[kBGR] = Mix(to[kBGR], kFrom == kBGRA ? from[kFrom - 1] : kOpaque, opacity);
    }
}

using CDrawRow = void (*)(uint8_t* to, const uint8_t* from, int32_t count, uint32_t opacity);

// Indexed by the formats of destination and source.
constexpr CDrawRow kDrawRow[kBlitFormats][kBlitFormats] = {
    {DrawRow<kBGRA, kBGRA>, DrawRow<kBGRA, kBGR>},
    {DrawRow<kBGR,  kBGRA>, DrawRow<kBGR,  kBGR>},
};

// One dimension of the drawn part, clipped to both pictures. In 64 bits, because positions can be any number.
struct Extent
{
    int64_t to;
    int64_t from;
    int64_t count;

    void Cut(int64_t toSize, int64_t fromSize)
    {
        const int64_t before = std::max({int64_t{0}, -to, -from});
        to += before;
        from += before;
        count = std::min({count - before, toSize - to, fromSize - from});
    }
};

bool CanDraw(const CPixelBuffer& buffer)
{
    return !buffer.IsEmpty() && buffer.GetFormat() < kBlitFormats;
}

void DrawRows(const CPixelLock& to, const CPixelView& from, const Extent& columns, const Extent& rows,
              CDrawRow draw, int32_t toBytes, int32_t fromBytes, uint8_t opacity)
{
    for (int64_t row = 0; row < rows.count; ++row)
        draw(to.Row(static_cast<int32_t>(rows.to + row)) + columns.to * toBytes,
             from.Row(static_cast<int32_t>(rows.from + row)) + columns.from * fromBytes,
             static_cast<int32_t>(columns.count), opacity);
}

} // namespace

bool Blit(CPixelBuffer& destination, int32_t x, int32_t y, const CPixelBuffer& source, int32_t sourceX,
          int32_t sourceY, int32_t width, int32_t height, uint8_t opacity)
{
    if (!CanDraw(destination) || !CanDraw(source))
        return false;
    if (&destination == &source)
    {
        // NOLINTNEXTLINE(performance-unnecessary-copy-initialization): rows can overlap, so draw from a copy
        const CPixelBuffer before(source);
        return Blit(destination, x, y, before, sourceX, sourceY, width, height, opacity);
    }
    Extent columns{x, sourceX, width};
    Extent rows{y, sourceY, height};
    columns.Cut(destination.GetWidth(), source.GetWidth());
    rows.Cut(destination.GetHeight(), source.GetHeight());
    if (columns.count <= 0 || rows.count <= 0 || opacity == 0)
        return true;
    const CPixelLock to(destination);
    const CPixelView from(source);
    if (!to || !from)
        return false;
    DrawRows(to, from, columns, rows, kDrawRow[destination.GetFormat()][source.GetFormat()],
             destination.GetBytesPerPixel(), source.GetBytesPerPixel(), opacity);
    return true;
}

} // namespace gw
