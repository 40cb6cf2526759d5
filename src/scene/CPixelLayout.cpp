#include "CPixelLayout.h"

#include "CFieldArchive.h"

namespace gw {

int32_t BytesPerPixel(int32_t format)
{
    constexpr int32_t kBytes[kPixelFormats] = {4, 3, 2, 2, 2, 1};
    return format < 0 || format >= kPixelFormats ? 0 : kBytes[format];
}

int64_t CPixelLayout::Stride() const
{
    const int32_t pixelBytes = BytesPerPixel(m_iFormat);
    if (pixelBytes == 0 || m_iWidth < 0)
        return -1;
    const int64_t bytes = int64_t{m_iWidth} * pixelBytes;
    return m_usRowAlignment ? (bytes + 3) / 4 * 4 : bytes;
}

void CPixelLayout::Fields(CFieldArchive& archive)
{
    archive.Signed("width", m_iWidth);
    archive.Signed("height", m_iHeight);
    archive.Signed("format", m_iFormat);
    archive.Word("row alignment", m_usRowAlignment);
    archive.Signed("horizontal resolution", m_iHorizontalResolution);
    archive.Signed("vertical resolution", m_iVerticalResolution);
}

int32_t CPixelLayout::RowsThatFollow(CFieldArchive& archive) const
{
    const int64_t stride = Stride();
    if (stride < 0 || m_iHeight < 0)
    {
        archive.Refuse(EFailure::BadCount);
        return 0;
    }
    return stride == 0 ? 0 : static_cast<int32_t>(archive.Fitting(m_iHeight, static_cast<size_t>(stride)));
}

} // namespace gw
