#include "CTempSingleFile.h"

namespace gw {

CTempSingleFile::~CTempSingleFile()
{
    Close(m_kView);
}

std::optional<uint32_t> CTempSingleFile::Allocate(uint64_t byteCount)
{
    const std::lock_guard lock(m_kSection);
    const View view{.m_uiSize = GetSize()};
    if (IsBlock(0) || byteCount != GetSize() || !Reserve(view))
        return std::nullopt;
    m_kView = view;
    return 0;
}

bool CTempSingleFile::Free(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    if (!IsBlock(block))
        return false;
    Close(m_kView);
    m_kView = {};
    return true;
}

std::byte* CTempSingleFile::Map(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    return IsBlock(block) ? Use(m_kView) : nullptr;
}

void CTempSingleFile::Unmap(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    if (IsBlock(block))
        Drop(m_kView);
}

} // namespace gw
