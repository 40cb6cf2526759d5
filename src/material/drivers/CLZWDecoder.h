#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// Decodes the codes of a GIF image, stored low bits first, up to twelve bits wide. A full table is kept
/// until a clear code.
class CLZWDecoder
{
public:
    /// `pixelBits` is the width of a pixel, 1 to 8.
    explicit CLZWDecoder(unsigned pixelBits);

    /// Decodes more bytes and appends pixels, up to a total count. Returns false for an invalid code. Ignores
    /// everything after the end code or the last pixel.
    bool Decode(std::span<const uint8_t> bytes, std::vector<uint8_t>& pixels, size_t pixelCount);

private:
    static constexpr unsigned kMostCodeBits = 12;
    static constexpr unsigned kTableSize = 1u << kMostCodeBits;
    static constexpr unsigned kNoCode = kTableSize;

    void Clear();
    bool Take(unsigned code, std::vector<uint8_t>& pixels);
    void Add(unsigned prefix, uint8_t last);
    void Emit(unsigned code, std::vector<uint8_t>& pixels) const;

    /// A string of pixels: another string plus a last pixel.
    struct Entry
    {
        uint16_t prefix;
        uint16_t length;
        uint8_t first;
        uint8_t last;
    };

    std::array<Entry, kTableSize> m_kTable{};
    unsigned m_uiClearCode;
    unsigned m_uiNextCode = 0; // next entry to be added
    unsigned m_uiCodeBits = 0;
    unsigned m_uiPrevious = kNoCode;
    unsigned m_uiPixelBits;
    uint32_t m_uiBits = 0; // read but not yet used, next ones in the low bits
    unsigned m_uiBitCount = 0;
    bool m_bEnded = false;
};

} // namespace gw
