#pragma once

#include "CPicture.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace gw {

class CPicInput;

/// One image of a GIF file, with its animation properties.
struct GIFImage
{
    PictureBox box;                       ///< position on the screen
    std::array<PixelRGBA, 256> palette{}; ///< the transparent entry has alpha 0, all others 255
    std::vector<uint8_t> pixels;          ///< indices into the palette, row by row from the top
    uint16_t delay = 0;                   ///< hundredths of a second
    uint8_t disposal = 0;                 ///< what happens to it before the next one
};

/// Reads the images of a GIF87a or GIF89a file in order. After a failure, reading cannot continue.
class CGIFReader
{
public:
    /// The input must outlive the reader.
    explicit CGIFReader(CPicInput& input) : input_(input) {}

    /// Reads everything before the first block. Returns false if this is not a GIF file.
    bool ReadHeader();
    /// Reads the next image. Returns false at the end of the file or for a damaged image, which is then
    /// undefined.
    bool ReadImage(GIFImage& image);
    int ScreenWidth() const { return m_iScreenWidth; }
    int ScreenHeight() const { return m_iScreenHeight; }

private:
    using Palette = std::array<PixelRGBA, 256>;
    /// The control extension of the next image.
    struct Control
    {
        uint16_t delay = 0;
        uint8_t disposal = 0;
        std::optional<uint8_t> transparent;
    };

    bool ReadPalette(uint8_t flags, Palette& palette);
    bool ReadExtension(Control& control);
    bool ReadControl(Control& control);
    bool ReadBlock(uint8_t& size);
    bool SkipBlocks();
    bool ReadDescriptor(const Control& control, GIFImage& image);
    bool ReadPixels(bool isInterlaced, GIFImage& image);

    CPicInput& input_;
    Palette m_kPalette{};
    int m_iScreenWidth = 0;
    int m_iScreenHeight = 0;
    uint8_t m_aBlock[255] = {}; // the bytes of one sub-block
};

} // namespace gw
