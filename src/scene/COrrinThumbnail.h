#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

class CFieldArchive;

/// The preview picture at the head of a container. The three words and the flag are carried along and read by
/// nobody.
struct COrrinThumbnail
{
    /// The stored fields, in file order. Without pixels width, height and format are written as 0.
    void Fields(CFieldArchive& archive);
    /// Bytes of a row of pixels: width x bytes per pixel, rounded up to a multiple of 4 under row alignment.
    int64_t Stride() const;

    int32_t m_iWidth = 0;
    int32_t m_iHeight = 0;
    int32_t m_iFormat = 0; ///< 0 to 5: 4, 3, 2, 2, 2 or 1 bytes per pixel
    uint16_t m_usRowAlignment = 0;
    int32_t m_iHorizontalResolution = 96; ///< dots per inch
    int32_t m_iVerticalResolution = 96;
    std::vector<uint8_t> m_kPixels; ///< Stride() x height bytes, or none
    uint32_t m_uiWordA = 1;
    uint32_t m_uiWordB = 0;
    uint8_t m_byFlag = 0;
    uint32_t m_uiWordC = 0;
};

} // namespace gw
