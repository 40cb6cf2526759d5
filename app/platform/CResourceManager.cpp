#include "CResourceManager.h"

#include "StringTable.h"

namespace gw {

namespace {

bool IsLeftToDefault(const std::string& text)
{
    return text.starts_with('*');
}

} // namespace

void CResourceManager::OpenLibrary(const std::string& path, uint32_t locale)
{
    m_kLibrary.Open(path);
    m_uiLocale = locale;
}

bool CResourceManager::LoadResString(int id, std::string& text) const
{
    if (id < 0)
        return false;
    if (!m_kLibrary.LoadString(static_cast<uint32_t>(id), m_uiLocale, text) || IsLeftToDefault(text))
        text = BuiltInString(id);
    return !text.empty() && !IsLeftToDefault(text);
}

} // namespace gw
