#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// Pixels of three bytes, red first, row by row from the top.
struct RgbPicture
{
    int width = 0;
    int height = 0;
    std::vector<uint8_t> rgb;

    RgbPicture() = default;
    RgbPicture(int w, int h) : width(w), height(h), rgb(RowBytes() * static_cast<size_t>(h)) {}

    size_t RowBytes() const { return size_t{3} * static_cast<size_t>(width); }
    /// Returns the three bytes of a pixel, which must be inside the picture.
    uint8_t* Pixel(int x, int y) { return rgb.data() + Offset(x, y); }
    const uint8_t* Pixel(int x, int y) const { return rgb.data() + Offset(x, y); }

private:
    size_t Offset(int x, int y) const
    {
        return RowBytes() * static_cast<size_t>(y) + size_t{3} * static_cast<size_t>(x);
    }
};

} // namespace gw
