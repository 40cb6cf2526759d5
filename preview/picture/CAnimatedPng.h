#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// An animated PNG, made of the encoded pictures of its frames. A program that does not know animations shows
/// the first one.
/// The format is APNG, which the third edition of PNG includes.
class CAnimatedPng
{
public:
    /// Every frame is shown for `delayNumerator` / `delayDenominator` seconds; the animation repeats for
    /// ever.
    CAnimatedPng(uint32_t frameCount, uint16_t delayNumerator, uint16_t delayDenominator)
        : m_uiFrameCount(frameCount), m_uiNumerator(delayNumerator), m_uiDenominator(delayDenominator)
    {
    }

    /// Returns the bytes that a frame adds to the file; the first one begins it. The frame is a whole PNG
    /// file, with the size and the kind of pixels of the others. Empty if it is not.
    std::string Frame(std::string_view png);
    /// Returns the bytes that end the file.
    static std::string End();

private:
    uint32_t m_uiFrameCount;
    uint16_t m_uiNumerator;
    uint16_t m_uiDenominator;
    uint32_t m_uiNextFrame = 0;
    uint32_t m_uiSequence = 0; ///< numbers the chunks of the animation
    std::string m_kHeader;
};

} // namespace gw
