#pragma once

#include "CDrawList.h"

#include <string>
#include <vector>

namespace gw {

/// A line with round ends, in pixels from the picture's upper left corner.
struct PictureLine
{
    float fromX;
    float fromY;
    float toX;
    float toY;
    LineColor color;
    float width;
};

/// A line of text. It is cut if it is too wide, and left out on a machine without fonts.
struct PictureLabel
{
    std::string text; ///< UTF-8
    int left = 0;
    int baseline = 0;
    int maxWidth = 0;
    int size = 12; ///< pixels per em
    LineColor color{};
};

/// A part of a picture: lines, which are clipped to it, and labels on top of them.
struct PicturePanel
{
    int left = 0;
    int top = 0;
    int width = 0;
    int height = 0;
    std::vector<PictureLine> lines; ///< later ones cover earlier ones
    std::vector<PictureLabel> labels;
};

} // namespace gw
