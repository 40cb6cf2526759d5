#pragma once

#include "CPrivateFile.h"

#include <optional>
#include <string>
#include <string_view>

namespace gw {

/// A profile that no folder of profiles holds: a private temporary file, gone with the object.
class CPrivateProfile
{
public:
    /// Replaces what was written before. False where the folder for temporary files takes none.
    bool Write(std::string_view text);
    /// Empty before the first Write.
    std::string Path() const { return m_kFile ? m_kFile->Path() : std::string(); }

private:
    std::optional<CPrivateFile> m_kFile;
};

} // namespace gw
