// Reads GIF files block by block. A file is a chain of extensions and images, each followed by sub-blocks of
// up to 255 bytes; every step consumes bytes, so reading ends. Sizes are checked before pixels are allocated.

#include "CGIFReader.h"

#include "CLZWDecoder.h"
#include "CPicInput.h"

#include <algorithm>
#include <cstring>
#include <span>
#include <string_view>

namespace gw {

namespace {

constexpr uint8_t kImageBlock = 0x2c;
constexpr uint8_t kExtensionBlock = 0x21;
constexpr uint8_t kControlLabel = 0xf9;
constexpr uint8_t kHasPalette = 0x80;
constexpr uint8_t kIsInterlaced = 0x40;
// far larger than any screen, but small enough for any machine
constexpr size_t kMostPixels = size_t{1} << 25;

// Interlaced images store their rows in four passes.
constexpr struct
{
    size_t first;
    size_t step;
} kPasses[] = {
    {0, 8},
    {4, 8},
    {2, 4},
    {1, 2},
};

std::vector<uint8_t> Deinterlaced(const std::vector<uint8_t>& stored, size_t width, size_t height)
{
    std::vector<uint8_t> pixels(stored.size());
    auto row = stored.begin();
    for (const auto& pass : kPasses)
    {
        for (size_t y = pass.first; y < height; y += pass.step, row += static_cast<ptrdiff_t>(width))
            std::copy_n(row, width, pixels.begin() + static_cast<ptrdiff_t>(y * width));
    }
    return pixels;
}

uint16_t WordAt(const uint8_t* bytes)
{
    return static_cast<uint16_t>(bytes[0] | bytes[1] << 8);
}

} // namespace

bool CGIFReader::ReadHeader()
{
    char signature[6];
    uint8_t screen[7];
    if (!input_.ReadValue(signature) || !input_.ReadValue(screen))
        return false;
    const std::string_view name(signature, 3);
    const std::string_view version(signature + 3, 3);
    if (name != "GIF" || (version != "87a" && version != "89a"))
        return false;
    m_iScreenWidth = WordAt(screen);
    m_iScreenHeight = WordAt(screen + 2);
    m_kPalette.fill({0, 0, 0, 255});
    return ReadPalette(screen[4], m_kPalette);
}

// Reads a color table if the flags announce one.
bool CGIFReader::ReadPalette(uint8_t flags, Palette& palette)
{
    if (!(flags & kHasPalette))
        return true;
    palette.fill({0, 0, 0, 255});
    const size_t count = size_t{2} << (flags & 7);
    for (size_t i = 0; i < count; ++i)
    {
        uint8_t color[3];
        if (!input_.ReadValue(color))
            return false;
        palette[i] = {color[0], color[1], color[2], 255};
    }
    return true;
}

bool CGIFReader::ReadImage(GIFImage& image)
{
    Control control;
    for (uint8_t block = 0; input_.ReadValue(block);)
    {
        if (block == kImageBlock)
            return ReadDescriptor(control, image);
        if (block != kExtensionBlock || !ReadExtension(control))
            return false;
    }
    return false;
}

bool CGIFReader::ReadExtension(Control& control)
{
    uint8_t label = 0;
    if (!input_.ReadValue(label))
        return false;
    if (label == kControlLabel && !ReadControl(control))
        return false;
    return SkipBlocks();
}

bool CGIFReader::ReadControl(Control& control)
{
    uint8_t size = 0;
    if (!ReadBlock(size) || size < 4)
        return false;
    const uint8_t flags = m_aBlock[0];
    control.disposal = flags >> 2 & 7;
    control.delay = WordAt(m_aBlock + 1);
    control.transparent = flags & 1 ? std::optional(m_aBlock[3]) : std::nullopt;
    return true;
}

// Reads a size and that many bytes; size 0 ends a chain of blocks.
bool CGIFReader::ReadBlock(uint8_t& size)
{
    return input_.ReadValue(size) && input_.Read(std::as_writable_bytes(std::span(m_aBlock).first(size)));
}

bool CGIFReader::SkipBlocks()
{
    uint8_t size = 0;
    while (ReadBlock(size))
    {
        if (size == 0)
            return true;
    }
    return false;
}

bool CGIFReader::ReadDescriptor(const Control& control, GIFImage& image)
{
    uint8_t place[9];
    if (!input_.ReadValue(place))
        return false;
    image.box = {WordAt(place), WordAt(place + 2), WordAt(place + 4), WordAt(place + 6)};
    image.delay = control.delay;
    image.disposal = control.disposal;
    image.palette = m_kPalette;
    if (!ReadPalette(place[8], image.palette))
        return false;
    if (control.transparent)
        image.palette[*control.transparent].a = 0;
    return ReadPixels(place[8] & kIsInterlaced, image);
}

// Missing pixels are a failure. Blocks after the last pixel are not needed, so a file can end there.
bool CGIFReader::ReadPixels(bool isInterlaced, GIFImage& image)
{
    const auto width = static_cast<size_t>(image.box.width);
    const auto height = static_cast<size_t>(image.box.height);
    const size_t count = width * height;
    uint8_t pixelBits = 0;
    if (!input_.ReadValue(pixelBits) || pixelBits < 1 || pixelBits > 8 || count == 0 || count > kMostPixels)
        return false;
    image.pixels.clear();
    image.pixels.reserve(count);
    CLZWDecoder decoder(pixelBits);
    uint8_t size = 0;
    while (ReadBlock(size) && size > 0)
    {
        if (!decoder.Decode(std::span(m_aBlock).first(size), image.pixels, count))
            return false;
    }
    if (image.pixels.size() < count)
        return false;
    if (isInterlaced)
        image.pixels = Deinterlaced(image.pixels, width, height);
    return true;
}

} // namespace gw
