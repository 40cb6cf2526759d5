// The writing half of CBMPPicture.

#include "CBMPPicture.h"

#include "Files.h"

#include <algorithm>
#include <cstring>

namespace gw {

namespace {

constexpr uint32_t kHeaderBytes = 54;

template <class... T>
bool Write(std::FILE* file, const T&... values)
{
    return (... && (std::fwrite(&values, sizeof values, 1, file) == 1));
}

} // namespace

bool CBMPPicture::OpenToWrite()
{
    m_pkOut = IsStandardStream(Name()) ? BinaryOutput() : OpenStream(Name(), "w");
    return m_pkOut != nullptr;
}

bool CBMPPicture::Close()
{
    const bool isWhole = m_bReading || (HasBegun() && m_iRow == m_iHeight);
    CloseFile();
    return isWhole && !m_bFailed;
}

void CBMPPicture::CloseFile()
{
    if (m_pkOut && (m_pkOut == stdout ? std::fflush(m_pkOut) : std::fclose(m_pkOut)) != 0)
        m_bFailed = true;
    m_pkOut = nullptr;
}

bool CBMPPicture::SetChannelCount(int count)
{
    if (!m_pkOut || HasBegun() || (count != 1 && count != 3))
        return false;
    m_iChannels = count;
    return true;
}

bool CBMPPicture::SetSize(const PictureBox& box)
{
    if (!m_pkOut || HasBegun() || box.width <= 0 || box.height <= 0)
        return false;
    m_iWidth = box.width;
    m_iHeight = box.height;
    return true;
}

// Rows are written in order. The part of a row without pixels is black.
bool CBMPPicture::BeginRow(int y, int x, int count)
{
    if (!m_pkOut || m_bFailed || y != m_iRow || !IsInside(y, x, count, Box()))
        return false;
    m_bFailed = !HasBegun() && !WriteHeader();
    if (m_bFailed)
        return false;
    std::ranges::fill(m_kRow, uint8_t{0});
    return true;
}

// Always top down, marked by a negative height.
bool CBMPPicture::WriteHeader()
{
    const uint64_t rowSize =
        (static_cast<uint64_t>(m_iWidth) * static_cast<unsigned>(m_iChannels) + 3) / 4 * 4;
    const uint64_t size = kHeaderBytes + rowSize * static_cast<uint64_t>(m_iHeight);
    if (size > UINT32_MAX)
        return false;
    m_uiRowSize = static_cast<uint32_t>(rowSize);
    m_kRow.resize(m_uiRowSize);
    const char type[] = {'B', 'M'};
    m_kFileHeader.size = static_cast<uint32_t>(size);
    m_kFileHeader.offset = kHeaderBytes;
    m_kInfoHeader.size = sizeof m_kInfoHeader;
    m_kInfoHeader.width = m_iWidth;
    m_kInfoHeader.height = -m_iHeight;
    m_kInfoHeader.planes = 1;
    m_kInfoHeader.bitCount = static_cast<uint16_t>(8 * m_iChannels);
    return Write(m_pkOut, type, m_kFileHeader.size, m_kFileHeader.reserved1, m_kFileHeader.reserved2,
                 m_kFileHeader.offset, m_kInfoHeader);
}

bool CBMPPicture::FinishRow()
{
    ++m_iRow;
    m_bFailed |= std::fwrite(m_kRow.data(), m_kRow.size(), 1, m_pkOut) != 1;
    return !m_bFailed;
}

uint8_t* CBMPPicture::ChannelsAt(int x)
{
    return &m_kRow[static_cast<size_t>(x) * static_cast<size_t>(m_iChannels)];
}

bool CBMPPicture::WriteRow(int y, int x, int count, const uint8_t* pixels)
{
    if (!BeginRow(y, x, count))
        return false;
    for (int i = 0; i < count; ++i)
        std::fill_n(ChannelsAt(x + i), m_iChannels, pixels[i]);
    return FinishRow();
}

bool CBMPPicture::WriteRowRGBA(int y, int x, int count, const PixelRGBA* pixels)
{
    if (!BeginRow(y, x, count))
        return false;
    for (int i = 0; i < count; ++i)
    {
        const PixelRGBA& pixel = pixels[i];
        uint8_t* const channels = ChannelsAt(x + i);
        channels[0] = m_iChannels == 1 ? Brightness(pixel) : pixel.b;
        if (m_iChannels == 1)
            continue;
        channels[1] = pixel.g;
        channels[2] = pixel.r;
    }
    return FinishRow();
}

} // namespace gw
