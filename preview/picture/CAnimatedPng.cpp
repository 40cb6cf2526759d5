// Frames come as whole PNG files. The first one keeps its chunks, with the animation's chunks in between; of
// the others only the pixels are taken, in chunks of another name that also have a number.

#include "CAnimatedPng.h"

#include <vector>

namespace gw {

namespace {

constexpr std::string_view kSignature = "\x89PNG\r\n\x1a\n";
constexpr size_t kFrameSize = 8; // bytes of IHDR with the width and the height

uint32_t ReadBig32(std::string_view bytes)
{
    uint32_t value = 0;
    for (const char byte : bytes.substr(0, 4))
        value = value << 8 | static_cast<unsigned char>(byte);
    return value;
}

void AppendBig(std::string& bytes, uint32_t value, int size)
{
    for (int shift = 8 * (size - 1); shift >= 0; shift -= 8)
        bytes += static_cast<char>(value >> shift & 0xff);
}

// CRC-32 of ISO 3309, as PNG uses it.
uint32_t Crc(std::string_view bytes)
{
    uint32_t crc = 0xffffffff;
    for (const char byte : bytes)
    {
        crc ^= static_cast<unsigned char>(byte);
        for (int bit = 0; bit < 8; ++bit)
            crc = crc >> 1 ^ (crc & 1 ? 0xedb88320u : 0u);
    }
    return ~crc;
}

// Appends a chunk: length, name, content, checksum of name and content.
void AppendChunk(std::string& file, std::string_view name, std::string_view content)
{
    AppendBig(file, static_cast<uint32_t>(content.size()), 4);
    const size_t start = file.size();
    file += name;
    file += content;
    AppendBig(file, Crc(std::string_view(file).substr(start)), 4);
}

struct PngChunks
{
    std::string_view header; ///< content of IHDR; empty if the file is not a PNG
    std::vector<std::string_view> pixels;
};

PngChunks ChunksOf(std::string_view png)
{
    PngChunks chunks;
    if (!png.starts_with(kSignature))
        return chunks;
    png.remove_prefix(kSignature.size());
    while (png.size() >= 12)
    {
        const size_t size = ReadBig32(png);
        if (size > png.size() - 12)
            return {};
        const std::string_view name = png.substr(4, 4);
        if (name == "IHDR" && size > kFrameSize)
            chunks.header = png.substr(8, size);
        if (name == "IDAT")
            chunks.pixels.push_back(png.substr(8, size));
        png.remove_prefix(12 + size);
    }
    return chunks;
}

} // namespace

std::string CAnimatedPng::Frame(std::string_view png)
{
    const PngChunks chunks = ChunksOf(png);
    const bool isFirst = m_uiNextFrame == 0;
    if (chunks.header.empty() || chunks.pixels.empty() || m_uiNextFrame == m_uiFrameCount ||
        (!isFirst && chunks.header != m_kHeader))
        return {};
    std::string file;
    if (isFirst)
    {
        m_kHeader = chunks.header;
        file += kSignature;
        AppendChunk(file, "IHDR", m_kHeader);
        std::string animation;
        AppendBig(animation, m_uiFrameCount, 4);
        AppendBig(animation, 0, 4); // repeats for ever
        AppendChunk(file, "acTL", animation);
    }
    std::string control;
    AppendBig(control, m_uiSequence++, 4);
    control += m_kHeader.substr(0, kFrameSize);
    AppendBig(control, 0, 4); // left
    AppendBig(control, 0, 4); // top
    AppendBig(control, m_uiNumerator, 2);
    AppendBig(control, m_uiDenominator, 2);
    AppendBig(control, 0, 2); // keep the frame until the next one replaces it
    AppendChunk(file, "fcTL", control);
    for (const std::string_view pixels : chunks.pixels)
    {
        std::string numbered;
        if (!isFirst)
            AppendBig(numbered, m_uiSequence++, 4);
        numbered += pixels;
        AppendChunk(file, isFirst ? "IDAT" : "fdAT", numbered);
    }
    ++m_uiNextFrame;
    return file;
}

std::string CAnimatedPng::End()
{
    std::string file;
    AppendChunk(file, "IEND", {});
    return file;
}

} // namespace gw
