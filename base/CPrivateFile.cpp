#include "CPrivateFile.h"

#include "Paths.h"
#include "PrivateNames.h"

#include <cerrno>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

int CreatePrivateFile(const std::string& folder, std::string_view extension, unsigned mode, std::string& path)
{
    constexpr int kAttempts = 16; // a second attempt is all but unheard of
    for (int i = 0; i < kAttempts; ++i)
    {
        path = PrivateName(folder, extension);
        const int file = open(path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, mode);
        if (file >= 0)
            return file;
        if (errno != EEXIST)
            break;
    }
    path.clear();
    return -1;
}

CPrivateFile::CPrivateFile(const std::string& besidePath, std::string_view extension)
{
    const int file = CreatePrivateFile(FolderOf(besidePath), extension, S_IRUSR | S_IWUSR, m_kPath);
    if (file >= 0)
        close(file);
}

CPrivateFile::~CPrivateFile()
{
    if (!m_kPath.empty())
        unlink(m_kPath.c_str());
}

} // namespace gw
