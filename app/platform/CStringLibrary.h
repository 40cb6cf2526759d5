#pragma once

#include "CMappedFile.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

namespace gw {

/// Finds a string of a Windows program or library by its id, in UTF-8. Of several languages the locale's is
/// taken, then one of the same primary language, then the neutral one, then the first. False when it is not
/// there or the file is damaged on the way to it; nothing in the file is trusted.
bool FindResourceString(std::span<const std::byte> file, uint32_t id, uint32_t locale, std::string& text);

/// The string table of a library file, which stays mapped.
class CStringLibrary
{
public:
    /// False when there is no such file; no string is found then.
    bool Open(const std::string& path);
    bool LoadString(uint32_t id, uint32_t locale, std::string& text) const;

private:
    CMappedFile m_kFile;
};

} // namespace gw
