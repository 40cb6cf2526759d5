#include "CGIFPicture.h"

#include <algorithm>
#include <cstdio>
#include <utility>

namespace gw {

CPicture* CGIFPicture::Open(const char* fileName, const char* mode)
{
    if (*mode == 'w')
        std::fputs("?GIF output not supported.\n", stderr);
    if (*mode != 'r')
        return nullptr;
    auto picture = std::make_unique<CGIFPicture>(fileName);
    const bool read =
        picture->m_kInput.Open(fileName) && picture->m_kReader.ReadHeader() && picture->NextPicture();
    return read ? picture.release() : nullptr;
}

// Keeps the current image if there is no next one.
bool CGIFPicture::NextPicture()
{
    GIFImage image;
    if (!m_kReader.ReadImage(image))
        return false;
    m_kImage = std::move(image);
    return true;
}

bool CGIFPicture::ReadRow(int y, int x, int count, uint8_t* pixels)
{
    if (!IsInside(y, x, count, Box()))
        return false;
    const size_t first =
        static_cast<size_t>(y) * static_cast<size_t>(m_kImage.box.width) + static_cast<size_t>(x);
    std::copy_n(m_kImage.pixels.begin() + static_cast<ptrdiff_t>(first), count, pixels);
    return true;
}

bool CGIFPicture::ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels)
{
    if (!IsInside(y, x, count, Box()))
        return false;
    const size_t first =
        static_cast<size_t>(y) * static_cast<size_t>(m_kImage.box.width) + static_cast<size_t>(x);
    for (size_t i = 0; i < static_cast<size_t>(count); ++i)
        pixels[i] = m_kImage.palette[m_kImage.pixels[first + i]];
    return true;
}

} // namespace gw
