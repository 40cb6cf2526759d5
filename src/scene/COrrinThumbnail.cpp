#include "COrrinThumbnail.h"

#include "CFieldArchive.h"

namespace gw {

namespace {

constexpr int kBytesPerPixel[] = {4, 3, 2, 2, 2, 1};

} // namespace

int64_t COrrinThumbnail::Stride() const
{
    if (m_iFormat < 0 || m_iFormat >= static_cast<int32_t>(std::size(kBytesPerPixel)))
        return -1;
    const int64_t bytes = static_cast<int64_t>(m_iWidth) * kBytesPerPixel[m_iFormat];
    return m_usRowAlignment ? (bytes + 3) / 4 * 4 : bytes;
}

void COrrinThumbnail::Fields(CFieldArchive& archive)
{
    if (m_kPixels.empty())
        m_iWidth = m_iHeight = m_iFormat = 0;
    archive.Signed("width", m_iWidth);
    archive.Signed("height", m_iHeight);
    archive.Signed("format", m_iFormat);
    archive.Word("row alignment", m_usRowAlignment);
    archive.Signed("horizontal resolution", m_iHorizontalResolution);
    archive.Signed("vertical resolution", m_iVerticalResolution);
    const bool present = archive.Presence("pixels", !m_kPixels.empty());
    if (archive.IsReading() && present)
    {
        const int64_t stride = Stride();
        // A size below 0, or a format that there is not: the bytes that follow cannot be told.
        if (stride < 0 || m_iHeight < 0)
            return archive.Refuse();
        const size_t rowBytes = static_cast<size_t>(stride);
        m_kPixels.resize(rowBytes == 0 ? 0 : archive.Fitting(m_iHeight, rowBytes) * rowBytes);
    }
    archive.Row("pixels", m_kPixels);
    archive.Unsigned("word A", m_uiWordA);
    archive.Unsigned("word B", m_uiWordB);
    archive.Byte("flag", m_byFlag);
    archive.Unsigned("word C", m_uiWordC);
}

} // namespace gw
