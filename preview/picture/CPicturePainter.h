#pragma once

#include "RgbPicture.h"

#include <cstddef>
#include <vector>

namespace gw {

struct GLScene;

/// Draws scenes without any display, and makes picture files. It stands in a module of its own, loaded for
/// the first picture; see LoadPicturePainter. Nothing here throws.
class CPicturePainter
{
public:
    virtual ~CPicturePainter() = default;

    /// Makes a surface of that many pixels, in place of one that is there. False where the machine's GL has
    /// none.
    virtual bool Begin(int width, int height) = 0;
    /// Draws a scene into the lower left part of the surface, and answers its pixels.
    virtual RgbPicture Paint(const GLScene& scene, int width, int height) = 0;
    virtual void End() = 0;
    /// The bytes of a PNG file; none for a picture without pixels.
    virtual std::vector<std::byte> EncodePng(const RgbPicture& picture) = 0;
};

/// The name under which the module gives out its painter, and the type of that function.
inline constexpr const char* kPicturePainterEntry = "gw_picture_painter";
using CPicturePainterEntry = CPicturePainter* (*)();

} // namespace gw
