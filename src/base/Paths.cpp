// Paths and folders. Errors of the file system count as "no" or "empty", because callers then report a
// missing file.

#include "Paths.h"

#include "PrivateNames.h"
#include "SystemError.h"
#include "Text.h"

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <memory>
#include <new>
#include <system_error>

#include <dirent.h>
#include <sys/auxv.h>
#include <sys/stat.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace gw {

namespace {

constexpr std::string_view kSeparators = "/\\";

fs::path NativePath(const std::string& path)
{
    return fs::path(std::u8string(path.begin(), path.end()));
}

std::string TextOf(const fs::path& path)
{
    const std::u8string text = path.u8string();
    return {text.begin(), text.end()};
}

bool IsRegular(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode);
}

std::string& SetFolder()
{
    static std::string folder;
    return folder;
}

} // namespace

PathParts SplitPath(std::string_view path)
{
    const size_t nameBegin = path.find_last_of(kSeparators) + 1; // npos + 1 is 0
    const std::string_view name = path.substr(nameBegin);
    const std::string_view stem = name.substr(0, name.rfind('.'));
    return {std::string(path.substr(0, nameBegin)), std::string(stem), std::string(name.substr(stem.size()))};
}

bool HasExtension(std::string_view path, std::string_view extension)
{
    return EqualNoCase(SplitPath(path).extension, extension);
}

std::string WithSeparator(std::string folder)
{
    if (!folder.empty() && kSeparators.find(folder.back()) == kSeparators.npos)
        folder += kPathSeparator;
    return folder;
}

bool FileExists(const std::string& path)
{
    std::error_code error;
    const fs::file_status status = fs::status(NativePath(path), error);
    return fs::exists(status) && !fs::is_directory(status);
}

bool FolderExists(const std::string& path)
{
    std::error_code error;
    return fs::is_directory(NativePath(path), error);
}

bool IsLink(const std::string& path)
{
    std::error_code error;
    return fs::is_symlink(NativePath(path), error);
}

bool IsFolderItself(const std::string& path)
{
    // With a trailing separator, the system would follow a link.
    const std::string bare = path.substr(0, path.find_last_not_of(kPathSeparator) + 1);
    struct stat status;
    return lstat(bare.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

bool FileSize(const std::string& path, uint64_t& byteCount)
{
    const fs::path native = NativePath(path);
    std::error_code error;
    if (!fs::is_regular_file(native, error))
        return false;
    const uintmax_t size = fs::file_size(native, error);
    if (error)
        return false;
    byteCount = size;
    return true;
}

bool IsReadOnly(const std::string& path)
{
    // Check the mode before calling access: for root, access allows writing to files without any write bit.
    struct stat status;
    if (stat(path.c_str(), &status) != 0)
        return false;
    return (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0 || access(path.c_str(), W_OK) != 0;
}

bool CreateFolder(const std::string& path)
{
    std::error_code error;
    fs::create_directories(NativePath(path), error);
    if (error)
        KeepSystemError(error.value());
    return FolderExists(path);
}

bool DeleteFile(const std::string& path)
{
    std::error_code error;
    return FileExists(path) && fs::remove(NativePath(path), error);
}

std::string FolderOf(const std::string& path)
{
    return path.substr(0, path.rfind(kPathSeparator) + 1); // npos + 1 is 0
}

// Not with the standard library's iterator: it ends the program if there is not enough memory for a path.
std::vector<std::string> FilesInFolder(const std::string& folder, std::string_view extension)
{
    // Most file systems list the type of each entry. Only links and unknown entries need a look.
    const auto isRegular = [&](const dirent& entry) {
        return entry.d_type == DT_REG || IsRegular(WithSeparator(folder) + entry.d_name);
    };
    std::vector<std::string> names;
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(opendir(folder.c_str()), closedir);
    if (!directory && errno == ENOMEM)
        throw std::bad_alloc();
    while (const dirent* entry = directory ? readdir(directory.get()) : nullptr)
    {
        if (HasExtension(entry->d_name, extension) && !IsPrivateName(entry->d_name) && isRegular(*entry))
            names.emplace_back(entry->d_name);
    }
    std::ranges::sort(names);
    return names;
}

std::string PathFrom(const std::string& folder, const std::string& relative)
{
    return TextOf((NativePath(folder) / NativePath(relative)).lexically_normal());
}

std::string TemporaryFolder()
{
    std::error_code error;
    const fs::path folder = fs::temp_directory_path(error);
    if (error)
        KeepSystemError(error.value());
    return error ? std::string() : WithSeparator(TextOf(folder));
}

std::string ExecutableFolder()
{
    if (!SetFolder().empty())
        return SetFolder();
    std::error_code error;
    fs::path program = fs::read_symlink("/proc/self/exe", error);
    if (error) // a root file system without /proc, such as a package build's
    {
        // NOLINTNEXTLINE(performance-no-int-to-ptr): the system passes this address as a number
        const auto* const path = reinterpret_cast<const char*>(getauxval(AT_EXECFN));
        program = fs::canonical(path, error);
    }
    return SplitPath(TextOf(program)).folder;
}

void SetExecutableFolder(std::string folder)
{
    SetFolder() = WithSeparator(std::move(folder));
}

} // namespace gw
