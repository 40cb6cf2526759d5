#include "CImageCache.h"

namespace gw {

namespace {

// Created before main, so it outlives every image.
[[maybe_unused]] const CImageCache& kBuiltAtStart = CImageCache::Instance();

} // namespace

CImageCache& CImageCache::Instance()
{
    static CImageCache cache;
    return cache;
}

void CImageCache::Enter(std::string_view path, CObject& image)
{
    const std::lock_guard lock(m_kMutex);
    m_kImages.emplace(path, &image);
}

void CImageCache::Remove(std::string_view path, const CObject* image)
{
    const std::lock_guard lock(m_kMutex);
    const auto [first, last] = m_kImages.equal_range(path);
    for (auto entry = first; entry != last;)
        entry = entry->second == image ? m_kImages.erase(entry) : std::next(entry);
}

void CImageCache::RemoveAll(std::string_view path)
{
    const std::lock_guard lock(m_kMutex);
    const auto [first, last] = m_kImages.equal_range(path);
    m_kImages.erase(first, last);
}

} // namespace gw
