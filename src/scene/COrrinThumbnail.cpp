#include "COrrinThumbnail.h"

#include "CFieldArchive.h"

namespace gw {

void COrrinThumbnail::Fields(CFieldArchive& archive)
{
    if (m_kPixels.empty())
        m_kLayout.m_iWidth = m_kLayout.m_iHeight = m_kLayout.m_iFormat = 0;
    m_kLayout.Fields(archive);
    const bool present = archive.Presence("pixels", !m_kPixels.empty());
    if (archive.IsReading() && present)
    {
        const auto rows = static_cast<size_t>(m_kLayout.RowsThatFollow(archive));
        m_kPixels.resize(rows == 0 ? 0 : rows * static_cast<size_t>(m_kLayout.Stride()));
    }
    archive.Row("pixels", m_kPixels);
    archive.Unsigned("word A", m_uiWordA);
    archive.Unsigned("word B", m_uiWordB);
    archive.Byte("flag", m_byFlag);
    archive.Unsigned("word C", m_uiWordC);
}

} // namespace gw
