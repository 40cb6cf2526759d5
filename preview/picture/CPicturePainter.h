#pragma once

#include "PicturePanel.h"
#include "RgbPicture.h"

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// Draws pictures without a display, and encodes picture files. It is in a module that is loaded for the
/// first picture; see LoadPicturePainter. It does not throw.
class CPicturePainter
{
public:
    virtual ~CPicturePainter() = default;

    /// Creates a surface of that size, replacing an existing one. Returns false if the machine's GL cannot.
    virtual bool Begin(int width, int height) = 0;
    /// Draws panels onto the surface, which has the color of the paper, and returns its pixels.
    virtual RgbPicture Paint(std::span<const PicturePanel> panels, LineColor paper) = 0;
    virtual void End() = 0;
    /// Returns the bytes of a PNG file; empty for a picture without pixels.
    virtual std::vector<std::byte> EncodePng(const RgbPicture& picture) = 0;
};

/// The module's exported function that returns its painter, and its type.
inline constexpr const char* kPicturePainterEntry = "gw_picture_painter";
using CPicturePainterEntry = CPicturePainter* (*)();

} // namespace gw
