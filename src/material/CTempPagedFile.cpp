#include "CTempPagedFile.h"

#include <algorithm>

namespace gw {

CTempPagedFile::~CTempPagedFile()
{
    for (auto& [page, view] : m_kBlocks)
        Close(view);
}

// Skips past each used page that it meets, so every page is checked once.
std::optional<uint32_t> CTempPagedFile::FirstFit(uint32_t pageCount) const
{
    uint32_t first = 0;
    for (uint32_t page = 0; page < kPageCount; ++page)
    {
        if (m_abPageInUse[page])
            first = page + 1;
        else if (page + 1 - first == pageCount)
            return first;
    }
    return std::nullopt;
}

std::optional<uint32_t> CTempPagedFile::Allocate(uint64_t byteCount)
{
    const std::lock_guard lock(m_kSection);
    if (byteCount > kFileBytes)
        return std::nullopt;
    const uint64_t pages = std::max<uint64_t>((byteCount + kPageBytes - 1) / kPageBytes, 1);
    const std::optional<uint32_t> first = FirstFit(static_cast<uint32_t>(pages));
    if (!first)
        return std::nullopt;
    const View view{.m_uiOffset = *first * kPageBytes, .m_uiSize = pages * kPageBytes};
    if (!Reserve(view))
        return std::nullopt;
    std::fill_n(m_abPageInUse.begin() + *first, pages, uint8_t{1});
    m_kBlocks.emplace(*first, view);
    return first;
}

bool CTempPagedFile::Free(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    const auto entry = m_kBlocks.find(block);
    if (entry == m_kBlocks.end())
        return false;
    std::fill_n(m_abPageInUse.begin() + block, entry->second.m_uiSize / kPageBytes, uint8_t{0});
    Close(entry->second);
    m_kBlocks.erase(entry);
    return m_kBlocks.empty();
}

std::byte* CTempPagedFile::Map(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    const auto entry = m_kBlocks.find(block);
    return entry == m_kBlocks.end() ? nullptr : Use(entry->second);
}

void CTempPagedFile::Unmap(uint32_t block)
{
    const std::lock_guard lock(m_kSection);
    const auto entry = m_kBlocks.find(block);
    if (entry != m_kBlocks.end())
        Drop(entry->second);
}

} // namespace gw
