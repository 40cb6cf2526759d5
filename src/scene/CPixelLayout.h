#pragma once

#include <cstdint>

namespace gw {

class CFieldArchive;

/// The number of pixel formats, which use 4, 3, 2, 2, 2 and 1 bytes per pixel.
inline constexpr int32_t kPixelFormats = 6;
/// Returns the bytes per pixel; 0 for an unknown format.
int32_t BytesPerPixel(int32_t format);

/// The layout of pixels in memory and in a container: size, format, row alignment, resolution.
struct CPixelLayout
{
    /// The stored fields, in file order.
    void Fields(CFieldArchive& archive);
    /// Returns the bytes per row: width x bytes per pixel, rounded up to a multiple of 4 with row alignment.
    /// Negative for a negative width or an unknown format.
    int64_t Stride() const;
    /// Call after a presence word that announces pixels. Returns the number of rows of Stride() bytes that
    /// follow, or 0 and a failure if it cannot be determined or the file is too short.
    int32_t RowsThatFollow(CFieldArchive& archive) const;

    int32_t m_iWidth = 0;
    int32_t m_iHeight = 0;
    int32_t m_iFormat = 0;
    uint16_t m_usRowAlignment = 0;
    int32_t m_iHorizontalResolution = 96; ///< dots per inch
    int32_t m_iVerticalResolution = 96;
};

} // namespace gw
