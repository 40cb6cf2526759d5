#include "CPictureLink.h"

#include "CFieldArchive.h"

namespace gw {

void CPictureLink::Set(const char* name, const CObject& owner)
{
    if (!IsNull())
        CImageCache::Instance().Remove(View(), &owner);
    m_pcFileName.Set(name && *name ? name : nullptr);
    m_pcStoredName.Set(nullptr);
    m_bUnread = false;
}

void CPictureLink::Field(CFieldArchive& archive)
{
    archive.Text("m_pcLinkFileName", m_pcStoredName.IsNull() ? m_pcFileName : m_pcStoredName);
}

void CPictureLink::Settle(const COrrinStream& stream)
{
    m_pcStoredName.Set(nullptr);
    if (!IsNull() && stream.HasBaseDirectory())
        m_pcStoredName.Set(StoredLinkName(stream.GetBaseDirectory(), GetFileName()).c_str());
}

} // namespace gw
