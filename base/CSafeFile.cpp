#include "CSafeFile.h"

#include "Paths.h"

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <random>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

constexpr unsigned kModeOfNew = 0666; // less the user's mask, as for any new file
constexpr unsigned kModeBits = 07777;
// Not the destination's, so that nobody who lists a folder by extension finds a half-written file.
constexpr std::string_view kPrivateExtension = ".tmp";

// Where a chain of symbolic links leads, be there a file or not. Empty for a ring.
std::string FollowLinks(const std::string& path)
{
    constexpr int kLinkLimit = 40; // the system's own
    std::filesystem::path target(path);
    for (int i = 0; i < kLinkLimit; ++i)
    {
        std::error_code error;
        const std::filesystem::path next = std::filesystem::read_symlink(target, error);
        if (error)
            return target.string();
        target = target.parent_path() / next;
    }
    return {};
}

std::string FolderOf(const std::string& path)
{
    return path.substr(0, path.rfind(kPathSeparator) + 1); // npos + 1 is 0
}

// A name that does not tell the destination's, so that a long one stays within the system's limit.
std::string PrivateName(const std::string& folder, std::string_view extension)
{
    std::random_device random;
    char name[32];
    std::snprintf(name, sizeof name, ".gaitwright-%08x%08x", random(), random());
    return folder + name + std::string(extension);
}

// Creates a file that nobody else has, in a folder with a separator at its end. Below 0 where the folder
// takes none.
int CreateUnique(const std::string& folder, std::string_view extension, unsigned mode, std::string& path)
{
    constexpr int kAttempts = 16; // names are 64 random bits: a second attempt is all but unheard of
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

// Whether a path is free or holds a file that may be replaced. `mode` becomes the file's, or 0 where the path
// is free.
bool MayReplace(const std::string& path, unsigned& mode)
{
    struct stat status;
    mode = 0;
    if (stat(path.c_str(), &status) != 0)
        return errno == ENOENT;
    mode = status.st_mode & kModeBits;
    return S_ISREG(status.st_mode) && !IsReadOnly(path);
}

} // namespace

CSafeFile::~CSafeFile()
{
    Discard();
}

bool CSafeFile::Open(const std::string& path)
{
    Discard();
    m_kPath = FollowLinks(path);
    const std::string folder = FolderOf(m_kPath);
    if (m_kPath == folder || !MayReplace(m_kPath, m_uiMode))
        return false;
    // A file that others may not read is not laid open while it is written.
    const unsigned mode = m_uiMode ? m_uiMode : kModeOfNew;
    m_iFile = CreateUnique(folder, kPrivateExtension, mode, m_kPrivatePath);
    return m_iFile >= 0;
}

bool CSafeFile::Write(std::string_view text)
{
    while (m_iFile >= 0 && !m_bFailed && !text.empty())
    {
        const ssize_t written = write(m_iFile, text.data(), text.size());
        if (written >= 0)
            text.remove_prefix(static_cast<size_t>(written));
        else if (errno != EINTR)
            m_bFailed = true;
    }
    return m_iFile >= 0 && !m_bFailed;
}

bool CSafeFile::Write(std::span<const std::byte> bytes)
{
    return Write(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size()));
}

bool CSafeFile::Commit()
{
    const int file = std::exchange(m_iFile, -1);
    if (file < 0)
        return false;
    bool good = !m_bFailed && (m_uiMode == 0 || fchmod(file, m_uiMode) == 0) && fsync(file) == 0;
    good = close(file) == 0 && good;
    good = good && rename(m_kPrivatePath.c_str(), m_kPath.c_str()) == 0;
    if (good)
        m_kPrivatePath.clear();
    Discard();
    return good;
}

void CSafeFile::Discard()
{
    if (m_iFile >= 0)
        close(std::exchange(m_iFile, -1));
    if (!m_kPrivatePath.empty())
        unlink(m_kPrivatePath.c_str());
    m_kPrivatePath.clear();
    m_kPath.clear();
    m_uiMode = 0;
    m_bFailed = false;
}

std::string CreatePrivateFile(const std::string& besidePath, std::string_view extension)
{
    std::string path;
    const int file = CreateUnique(FolderOf(besidePath), extension, kModeOfNew, path);
    if (file >= 0)
        close(file);
    return path;
}

} // namespace gw
