// Opens, closes and reads BMP files; BMPWriter.cpp writes them.

#include "CBMPPicture.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace gw {

namespace {

constexpr uint16_t kBMPType = 19778; // "BM"
constexpr uint32_t kInfoHeaderBytes = 40;
constexpr int kDepths[] = {1, 2, 4, 8, 16, 24, 32};
constexpr uint64_t kStreamRowLimit = uint64_t{1} << 25; // for a stream of unknown size

static_assert(sizeof(BMPInfoHeader) == kInfoHeaderBytes);

// Expands five bits to eight by repeating the high bits, so that the ends are 0 and 255.
constexpr std::array<uint8_t, 32> MakeFiveBitTable()
{
    std::array<uint8_t, 32> table{};
    for (unsigned i = 0; i < table.size(); ++i)
        table[i] = static_cast<uint8_t>(i << 3 | i >> 2);
    return table;
}

constexpr std::array<uint8_t, 32> kFiveBits = MakeFiveBitTable();

} // namespace

CPicture* CBMPPicture::Open(const char* fileName, const char* mode)
{
    auto picture = std::make_unique<CBMPPicture>(fileName);
    const bool opened = *mode == 'r' ? picture->OpenToRead() : *mode == 'w' && picture->OpenToWrite();
    return opened ? picture.release() : nullptr;
}

bool CBMPPicture::OpenToRead()
{
    m_bReading = true;
    if (m_kInput.Open(Name()) && ReadHeader())
        return true;
    std::fprintf(stderr, "%s: read header failed.\n", Name().c_str());
    return false;
}

bool CBMPPicture::ReadHeader()
{
    if (!ReadFileHeader() || !ReadInfoHeader() || !TakeSize())
        return false;
    if (m_kInfoHeader.bitCount < 16 && !ReadPalette())
        return false;
    // Only forward: if the offset is before the current position, the pixels follow immediately.
    m_kFileHeader.offset = std::max(m_kFileHeader.offset, static_cast<uint32_t>(m_kInput.Position()));
    if (!m_kInput.Seek(m_kFileHeader.offset))
        return false;
    const uint64_t wholeBlock = uint64_t{m_uiRowSize} * static_cast<uint64_t>(m_iHeight);
    if (!m_kInput.MayHold(m_bTopDown ? m_uiRowSize : wholeBlock))
        return false;
    m_kRow.resize(m_uiRowSize);
    return true;
}

bool CBMPPicture::ReadFileHeader()
{
    const bool read = m_kInput.ReadValue(m_kFileHeader.type) && m_kInput.ReadValue(m_kFileHeader.size) &&
                      m_kInput.ReadValue(m_kFileHeader.reserved1) &&
                      m_kInput.ReadValue(m_kFileHeader.reserved2) && m_kInput.ReadValue(m_kFileHeader.offset);
    if (!read)
        return false;
    if (m_kFileHeader.type == kBMPType)
        return true;
    std::fprintf(stderr, "%s doesn't begin with 'BM'.\n", Name().c_str());
    return false;
}

bool CBMPPicture::ReadInfoHeader()
{
    // A smaller header has other fields: an older format with the same name.
    if (!m_kInput.ReadValue(m_kInfoHeader) || m_kInfoHeader.size < kInfoHeaderBytes)
        return false;
    if (m_kInfoHeader.compression == 0)
        return m_kInput.Skip(m_kInfoHeader.size - kInfoHeaderBytes);
    std::fprintf(stderr, "%s is compressed; only BI_RGB supported.\n", Name().c_str());
    return false;
}

bool CBMPPicture::TakeSize()
{
    const int depth = m_kInfoHeader.bitCount;
    if (std::ranges::find(kDepths, depth) == std::end(kDepths))
    {
        std::fprintf(stderr, "%s has unsupported bit depth %d\n", Name().c_str(), depth);
        return false;
    }
    const int64_t height = m_kInfoHeader.height;
    m_bTopDown = height < 0;
    if (m_kInfoHeader.width <= 0 || height == 0 || height == INT32_MIN)
        return false;
    m_iWidth = m_kInfoHeader.width;
    m_iHeight = static_cast<int>(std::abs(height));
    m_iChannels = 3;
    const uint64_t rowSize = (static_cast<uint64_t>(m_iWidth) * static_cast<unsigned>(depth) + 31) / 32 * 4;
    if (rowSize > UINT32_MAX || (m_kInput.IsStream() && rowSize > kStreamRowLimit))
        return false;
    m_uiRowSize = static_cast<uint32_t>(rowSize);
    return true;
}

// As many entries as the bit depth can address. A file can have fewer, shown by the position of its pixels;
// without any, the picture is gray.
bool CBMPPicture::ReadPalette()
{
    const size_t count = size_t{1} << m_kInfoHeader.bitCount;
    const uint64_t position = m_kInput.Position();
    size_t held = count;
    if (m_kFileHeader.offset >= position)
        held = static_cast<size_t>(std::min<uint64_t>(count, (m_kFileHeader.offset - position) / 4));
    for (size_t i = 0; i < held; ++i)
    {
        uint8_t entry[4];
        if (!m_kInput.ReadValue(entry))
            return false;
        m_kPalette[i] = {entry[2], entry[1], entry[0], 255};
    }
    for (size_t i = held; i < count; ++i)
    {
        const auto grey = static_cast<uint8_t>(held == 0 ? i * 255 / (count - 1) : 0);
        m_kPalette[i] = {grey, grey, grey, 255};
    }
    return true;
}

// Stored rows count from the start of the file's block; for a stream that is bottom up, from its end.
bool CBMPPicture::ReadRowBytes(int y, int x, int count)
{
    if (!m_bReading || !IsInside(y, x, count, Box()))
        return false;
    const int row = m_kInput.IsStream() && !m_bTopDown ? m_iHeight - y - 1 : y;
    if (row == m_iHeldRow)
        return true; // a pipe cannot seek back
    if (!m_kInput.Seek(m_kFileHeader.offset + uint64_t{m_uiRowSize} * static_cast<uint64_t>(row)))
        return false;
    const bool read = m_kInput.Read(std::as_writable_bytes(std::span(m_kRow)));
    m_iHeldRow = read ? row : -1;
    return read;
}

// The first pixel is in the high bits.
uint8_t CBMPPicture::IndexAt(int x) const
{
    const unsigned depth = m_kInfoHeader.bitCount;
    const size_t bit = static_cast<size_t>(x) * depth;
    const unsigned shift = 8 - depth - static_cast<unsigned>(bit % 8);
    return static_cast<uint8_t>(m_kRow[bit / 8] >> shift & ((1u << depth) - 1));
}

PixelRGBA CBMPPicture::PixelAt(int x) const
{
    const unsigned depth = m_kInfoHeader.bitCount;
    if (depth < 16)
        return m_kPalette[IndexAt(x)];
    const uint8_t* const bytes = &m_kRow[static_cast<size_t>(x) * depth / 8];
    if (depth > 16)
        return {bytes[2], bytes[1], bytes[0], depth == 32 ? bytes[3] : uint8_t{255}};
    const unsigned word = bytes[0] | static_cast<unsigned>(bytes[1]) << 8;
    return {kFiveBits[word >> 10 & 31], kFiveBits[word >> 5 & 31], kFiveBits[word & 31], 255};
}

bool CBMPPicture::ReadRow(int y, int x, int count, uint8_t* pixels)
{
    if (!ReadRowBytes(y, x, count))
        return false;
    for (int i = 0; i < count; ++i)
        pixels[i] = m_kInfoHeader.bitCount < 16 ? IndexAt(x + i) : Brightness(PixelAt(x + i));
    return true;
}

bool CBMPPicture::ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels)
{
    if (!ReadRowBytes(y, x, count))
        return false;
    for (int i = 0; i < count; ++i)
        pixels[i] = PixelAt(x + i);
    return true;
}

} // namespace gw
