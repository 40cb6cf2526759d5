#pragma once

#include "CPixelLayout.h"

#include <cstdint>
#include <vector>

namespace gw {

/// The preview picture at the start of a container. The three words and the flag are preserved but not used.
struct COrrinThumbnail
{
    /// The stored fields, in file order. Without pixels, width, height and format are written as 0.
    void Fields(CFieldArchive& archive);

    CPixelLayout m_kLayout;
    std::vector<uint8_t> m_kPixels; ///< stride x height bytes, or empty
    uint32_t m_uiWordA = 1;
    uint32_t m_uiWordB = 0;
    uint8_t m_byFlag = 0;
    uint32_t m_uiWordC = 0;
};

} // namespace gw
