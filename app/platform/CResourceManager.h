#pragma once

#include "CStringLibrary.h"

#include <cstdint>
#include <string>

namespace gw {

/// The library of translated strings, in the data folder.
inline constexpr const char* kResourceLibrary = "GaitForgeRes.dll";

/// Texts of messages: from the resource library if it has one, otherwise from the program's own table.
class CResourceManager
{
public:
    /// Opens a library of translated strings. A missing or damaged one is not an error. The locale selects
    /// one of the library's languages.
    void OpenLibrary(const std::string& path, uint32_t locale);

    /// Loads the text of a message. Returns false if it is missing or starts with "*". In the library, "*"
    /// marks a text that is not translated and comes from the program's table.
    bool LoadResString(int id, std::string& text) const;

private:
    CStringLibrary m_kLibrary;
    uint32_t m_uiLocale = 0;
};

} // namespace gw
