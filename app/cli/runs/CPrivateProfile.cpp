#include "CPrivateProfile.h"

#include "Paths.h"

#include <filesystem>
#include <system_error>

namespace gw {

bool CPrivateProfile::Write(std::string_view text)
{
    std::error_code error;
    const std::string folder = WithSeparator(std::filesystem::temp_directory_path(error).string());
    if (!m_kFile && !error)
        m_kFile.emplace(folder, ".prf");
    return m_kFile && m_kFile->Write(text);
}

} // namespace gw
