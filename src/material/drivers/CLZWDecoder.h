#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// Decodes the codes of a GIF image, which stand low bits first and grow up to twelve bits. A table that is
/// full stays as it is until a clear code comes.
class CLZWDecoder
{
public:
    /// The width of a pixel in bits, from 1 to 8.
    explicit CLZWDecoder(unsigned pixelBits);

    /// Appends the pixels of some more bytes, up to a count of all pixels. False for a code that cannot stand
    /// here. What comes behind the end code or the last pixel is passed over.
    bool Decode(std::span<const uint8_t> bytes, std::vector<uint8_t>& pixels, size_t pixelCount);

private:
    static constexpr unsigned kMostCodeBits = 12;
    static constexpr unsigned kTableSize = 1u << kMostCodeBits;
    static constexpr unsigned kNoCode = kTableSize;

    void Clear();
    bool Take(unsigned code, std::vector<uint8_t>& pixels);
    void Add(unsigned prefix, uint8_t last);
    void Emit(unsigned code, std::vector<uint8_t>& pixels) const;

    /// A string of pixels: another one and a last pixel.
    struct Entry
    {
        uint16_t prefix;
        uint16_t length;
        uint8_t first;
        uint8_t last;
    };

    std::array<Entry, kTableSize> m_kTable{};
    unsigned m_uiClearCode;
    unsigned m_uiNextCode = 0; // the entry that is made next
    unsigned m_uiCodeBits = 0;
    unsigned m_uiPrevious = kNoCode;
    unsigned m_uiPixelBits;
    uint32_t m_uiBits = 0; // read and not yet taken, the next ones low
    unsigned m_uiBitCount = 0;
    bool m_bEnded = false;
};

} // namespace gw
