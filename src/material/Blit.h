#pragma once

#include "CPixelBuffer.h"

namespace gw {

/// An opacity, or a byte of alpha, that lets nothing through.
inline constexpr uint8_t kOpaque = 255;

/// Draws a part of a picture on another one, cut to both. Opacity goes from 0, which changes nothing, to 255,
/// which copies; between them every byte of a pixel is mixed. Pixels without alpha count as opaque. False for
/// formats other than 0 and 1, and where pixels cannot be mapped.
bool Blit(CPixelBuffer& destination, int32_t x, int32_t y, const CPixelBuffer& source, int32_t sourceX,
          int32_t sourceY, int32_t width, int32_t height, uint8_t opacity);

} // namespace gw
