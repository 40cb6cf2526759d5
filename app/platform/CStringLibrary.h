#pragma once

#include "CMappedFile.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

namespace gw {

/// Finds a string of a Windows program or library by id and stores it as UTF-8. Prefers the locale's
/// language, then the same primary language, then the neutral one, then the first. Returns false if it is not
/// found or the file is damaged; the file is not trusted.
bool FindResourceString(std::span<const std::byte> file, uint32_t id, uint32_t locale, std::string& text);

/// The string table of a library file, which stays mapped.
class CStringLibrary
{
public:
    /// Returns false if the file does not exist; then no strings are found.
    bool Open(const std::string& path);
    bool LoadString(uint32_t id, uint32_t locale, std::string& text) const;

private:
    CMappedFile m_kFile;
};

} // namespace gw
