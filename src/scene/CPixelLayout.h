#pragma once

#include <cstdint>

namespace gw {

class CFieldArchive;

/// The number of pixel formats, which have 4, 3, 2, 2, 2 and 1 bytes a pixel.
inline constexpr int32_t kPixelFormats = 6;
/// Bytes of a pixel; 0 for a format that there is not.
int32_t BytesPerPixel(int32_t format);

/// How pixels lie in memory and in a container: size, format, alignment of rows, resolution.
struct CPixelLayout
{
    /// The stored fields, in file order.
    void Fields(CFieldArchive& archive);
    /// Bytes of a row: width x bytes per pixel, rounded up to a multiple of 4 under row alignment. Below 0
    /// for a width below 0 and for a format that there is not.
    int64_t Stride() const;
    /// Behind a presence word that says that pixels follow: how many rows of Stride() bytes they are. None,
    /// and damage, where that cannot be told or the file cannot hold them.
    int32_t RowsThatFollow(CFieldArchive& archive) const;

    int32_t m_iWidth = 0;
    int32_t m_iHeight = 0;
    int32_t m_iFormat = 0;
    uint16_t m_usRowAlignment = 0;
    int32_t m_iHorizontalResolution = 96; ///< dots per inch
    int32_t m_iVerticalResolution = 96;
};

} // namespace gw
