#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// Pixels of three bytes, red first, row after row from the top.
struct RgbPicture
{
    int width = 0;
    int height = 0;
    std::vector<uint8_t> rgb;

    RgbPicture() = default;
    RgbPicture(int w, int h) : width(w), height(h), rgb(RowBytes() * static_cast<size_t>(h)) {}

    size_t RowBytes() const { return size_t{3} * static_cast<size_t>(width); }
    /// The three bytes of a pixel inside.
    uint8_t* Pixel(int x, int y) { return rgb.data() + Offset(x, y); }
    const uint8_t* Pixel(int x, int y) const { return rgb.data() + Offset(x, y); }

private:
    size_t Offset(int x, int y) const
    {
        return RowBytes() * static_cast<size_t>(y) + size_t{3} * static_cast<size_t>(x);
    }
};

} // namespace gw
