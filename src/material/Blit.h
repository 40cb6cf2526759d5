#pragma once

#include "CPixelBuffer.h"

namespace gw {

/// Full opacity, and the alpha byte of an opaque pixel.
inline constexpr uint8_t kOpaque = 255;

/// Draws part of a picture onto another, clipped to both. Opacity 0 changes nothing, 255 copies; in between,
/// every byte is blended. Pixels without alpha count as opaque. Returns false for formats other than 0 and 1,
/// and if pixels cannot be mapped.
bool Blit(CPixelBuffer& destination, int32_t x, int32_t y, const CPixelBuffer& source, int32_t sourceX,
          int32_t sourceY, int32_t width, int32_t height, uint8_t opacity);

} // namespace gw
