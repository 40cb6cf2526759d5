#pragma once

#include "CStringLibrary.h"

#include <cstdint>
#include <string>

namespace gw {

/// The library of translated strings, in the data folder.
inline constexpr const char* kResourceLibrary = "GaitForgeRes.dll";

/// Every message's text: from the resource library where it has one, else from the program's own table.
class CResourceManager
{
public:
    /// Takes a library of translated strings; a missing or broken one is no error. The locale chooses among
    /// the library's languages.
    void OpenLibrary(const std::string& path, uint32_t locale);

    /// False when no text was found or the one found begins with "*". A "*" in the library marks a text that
    /// the translation leaves to the program's table.
    bool LoadResString(int id, std::string& text) const;

private:
    CStringLibrary m_kLibrary;
    uint32_t m_uiLocale = 0;
};

} // namespace gw
