// LZW decoding. The table starts with all single pixels, a clear code and an end code. Each code stands for a
// string of pixels and adds one entry: the previous string plus the first pixel of the current one. Entries
// are stored as a link to an older entry plus a last pixel, so a chain always ends, and its known length lets
// a string be written from back to front. A code beyond the next entry is invalid. Output is limited to the
// image's pixels, so a few bytes cannot fill the memory.

#include "CLZWDecoder.h"

namespace gw {

CLZWDecoder::CLZWDecoder(unsigned pixelBits) : m_uiClearCode(1u << pixelBits), m_uiPixelBits(pixelBits)
{
    for (unsigned i = 0; i < m_uiClearCode; ++i)
        m_kTable[i] = {0, 1, static_cast<uint8_t>(i), static_cast<uint8_t>(i)};
    Clear();
}

void CLZWDecoder::Clear()
{
    m_uiNextCode = m_uiClearCode + 2;
    m_uiCodeBits = m_uiPixelBits + 1;
    m_uiPrevious = kNoCode;
}

bool CLZWDecoder::Decode(std::span<const uint8_t> bytes, std::vector<uint8_t>& pixels, size_t pixelCount)
{
    for (const uint8_t byte : bytes)
    {
        if (m_bEnded || pixels.size() >= pixelCount)
            break;
        m_uiBits |= static_cast<uint32_t>(byte) << m_uiBitCount;
        m_uiBitCount += 8;
        while (m_uiBitCount >= m_uiCodeBits && !m_bEnded && pixels.size() < pixelCount)
        {
            const unsigned code = m_uiBits & ((1u << m_uiCodeBits) - 1);
            m_uiBits >>= m_uiCodeBits;
            m_uiBitCount -= m_uiCodeBits;
            if (!Take(code, pixels))
                return false;
        }
    }
    if (pixels.size() > pixelCount)
        pixels.resize(pixelCount);
    return true;
}

// A new entry consists of the previous string and the first pixel of the current one. The current code can
// refer to that very entry.
bool CLZWDecoder::Take(unsigned code, std::vector<uint8_t>& pixels)
{
    if (code == m_uiClearCode)
    {
        Clear();
        return true;
    }
    if (code == m_uiClearCode + 1)
    {
        m_bEnded = true;
        return true;
    }
    const bool isFirst = m_uiPrevious == kNoCode;
    const bool isNext = code == m_uiNextCode;
    if (isFirst ? code > m_uiClearCode : code > m_uiNextCode)
        return false;
    if (!isFirst)
        Add(m_uiPrevious, m_kTable[isNext ? m_uiPrevious : code].first);
    Emit(code, pixels);
    m_uiPrevious = code;
    // Also after the first code, which adds no entry: for 1-bit pixels it is the last code of two bits.
    if (m_uiNextCode == 1u << m_uiCodeBits && m_uiCodeBits < kMostCodeBits)
        ++m_uiCodeBits;
    return true;
}

void CLZWDecoder::Add(unsigned prefix, uint8_t last)
{
    if (m_uiNextCode >= kTableSize)
        return;
    const Entry& before = m_kTable[prefix];
    m_kTable[m_uiNextCode] = {static_cast<uint16_t>(prefix), static_cast<uint16_t>(before.length + 1),
                              before.first, last};
    ++m_uiNextCode;
}

// Backwards, because entries are chained from the last pixel to the first.
void CLZWDecoder::Emit(unsigned code, std::vector<uint8_t>& pixels) const
{
    const size_t length = m_kTable[code].length;
    pixels.resize(pixels.size() + length);
    auto out = pixels.rbegin();
    for (size_t i = 0; i < length; ++i, ++out)
    {
        *out = m_kTable[code].last;
        code = m_kTable[code].prefix;
    }
}

} // namespace gw
