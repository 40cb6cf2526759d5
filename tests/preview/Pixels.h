#pragma once

#include "CDrawList.h"
#include "RgbPicture.h"

namespace gw {

/// Part of a picture, between the first two and the last two numbers.
struct PixelArea
{
    int left;
    int top;
    int right;
    int bottom;
};

inline PixelArea WholeOf(const RgbPicture& picture)
{
    return {0, 0, picture.width, picture.height};
}

/// Returns the number of pixels in an area with exactly this color.
inline int CountColor(const RgbPicture& picture, LineColor color, const PixelArea& area)
{
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y)
    {
        for (int x = area.left; x < area.right; ++x)
        {
            const uint8_t* const pixel = picture.Pixel(x, y);
            count += LineColor{pixel[0], pixel[1], pixel[2]} == color ? 1 : 0;
        }
    }
    return count;
}

inline int CountColor(const RgbPicture& picture, LineColor color)
{
    return CountColor(picture, color, WholeOf(picture));
}

} // namespace gw
