#include "CPrivateProfile.h"

#include "CSafeFile.h"
#include "Paths.h"

#include <filesystem>
#include <system_error>

namespace gw {

CPrivateProfile::~CPrivateProfile()
{
    if (!m_kPath.empty())
        DeleteFile(m_kPath);
}

bool CPrivateProfile::Write(std::string_view text)
{
    std::error_code error;
    const std::string folder = WithSeparator(std::filesystem::temp_directory_path(error).string());
    if (m_kPath.empty() && !error)
        m_kPath = CreatePrivateFile(folder + "gaitwright", ".prf");
    CSafeFile file;
    return !m_kPath.empty() && file.Open(m_kPath) && file.Write(text) && file.Commit();
}

} // namespace gw
