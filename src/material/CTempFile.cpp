#include "CTempFile.h"

namespace gw {

CTempFile::CTempFile(const std::string& folder, uint64_t byteCount, bool takesBlocks)
    : m_kFile(folder, byteCount), m_uiSize(byteCount), m_bTakesBlocks(takesBlocks)
{
}

CTempFile::~CTempFile() = default;

bool CTempFile::Reserve(const View& view)
{
    return m_kFile.Reserve(view.m_uiOffset, view.m_uiSize);
}

std::byte* CTempFile::Use(View& view)
{
    if (!view.m_pkAddress)
        view.m_pkAddress = m_kFile.Map(view.m_uiOffset, view.m_uiSize);
    if (view.m_pkAddress)
        ++view.m_iUses;
    return view.m_pkAddress;
}

void CTempFile::Drop(View& view)
{
    if (view.m_iUses > 0 && --view.m_iUses == 0)
        Close(view);
}

void CTempFile::Close(View& view)
{
    if (view.m_pkAddress)
        CMappingFile::Unmap(view.m_pkAddress, view.m_uiSize);
    view.m_pkAddress = nullptr;
    view.m_iUses = 0;
}

} // namespace gw
