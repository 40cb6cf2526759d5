// Paths and folders. Errors of the file system count as "no" or "empty", because callers then report a
// missing file.

#include "Paths.h"

#include "Files.h"
#include "NativePath.h"
#include "PrivateNames.h"
#include "SystemError.h"
#include "Text.h"

#include <algorithm>
#include <filesystem>
#include <new>

namespace gw {

namespace {

constexpr std::string_view kSeparators = "/\\";

std::string& SetFolder()
{
    static std::string folder;
    return folder;
}

// Returns what follows the last separator.
std::string_view NameIn(std::string_view path)
{
    return path.substr(path.find_last_of(kSeparators) + 1); // npos + 1 is 0
}

// Returns a name without its extension.
std::string_view StemIn(std::string_view name)
{
    return name.substr(0, name.rfind('.'));
}

} // namespace

PathParts SplitPath(std::string_view path)
{
    const std::string_view name = NameIn(path);
    const std::string_view stem = StemIn(name);
    return {std::string(path.substr(0, path.size() - name.size())), std::string(stem),
            std::string(name.substr(stem.size()))};
}

bool HasExtension(std::string_view path, std::string_view extension)
{
    const std::string_view name = NameIn(path);
    return EqualNoCase(name.substr(StemIn(name).size()), extension);
}

std::string WithSeparator(std::string folder)
{
    if (!folder.empty() && kSeparators.find(folder.back()) == kSeparators.npos)
        folder += kPathSeparator;
    return folder;
}

bool FileExists(const std::string& path)
{
    FileStatus status;
    return StatusOf(path, status) && status.kind != EFileKind::Folder;
}

bool FolderExists(const std::string& path)
{
    FileStatus status;
    return StatusOf(path, status) && status.kind == EFileKind::Folder;
}

bool IsSameFile(const std::string& a, const std::string& b)
{
    std::error_code error;
    return std::filesystem::equivalent(NativePath(a), NativePath(b), error);
}

bool IsLink(const std::string& path)
{
    FileStatus status;
    return StatusOfLink(path, status) && status.kind == EFileKind::Link;
}

bool IsFolderItself(const std::string& path)
{
    // With a trailing separator, the system would follow a link.
    const std::string bare = path.substr(0, path.find_last_not_of(kPathSeparator) + 1);
    FileStatus status;
    return StatusOfLink(bare, status) && status.kind == EFileKind::Folder;
}

bool FileSize(const std::string& path, uint64_t& byteCount)
{
    FileStatus status;
    if (!StatusOf(path, status) || status.kind != EFileKind::Regular)
        return false;
    byteCount = status.byteCount;
    return true;
}

bool DeleteFile(const std::string& path)
{
    return FileExists(path) && RemoveFile(path.c_str());
}

std::string FolderOf(const std::string& path)
{
    return path.substr(0, path.find_last_of(kSystemSeparators) + 1); // npos + 1 is 0
}

std::vector<std::string> FilesInFolder(const std::string& folder, std::string_view extension)
{
    // Only links and unknown entries need a look.
    const auto isRegular = [&](const FolderEntry& entry) {
        uint64_t byteCount = 0;
        return entry.kind == EFileKind::Regular || FileSize(WithSeparator(folder) + entry.name, byteCount);
    };
    std::vector<std::string> names;
    const bool isListed = ListFolder(folder, [&](const FolderEntry& entry) {
        if (HasExtension(entry.name, extension) && !IsPrivateName(entry.name) && isRegular(entry))
            names.emplace_back(entry.name);
        return true;
    });
    if (!isListed && IsOutOfMemory(LastSystemError()))
        throw std::bad_alloc();
    std::ranges::sort(names);
    return names;
}

std::string PathFrom(const std::string& folder, const std::string& relative)
{
    return PathText((NativePath(folder) / NativePath(relative)).lexically_normal());
}

std::string ExecutableFolder()
{
    return SetFolder().empty() ? ProgramFolder() : SetFolder();
}

void SetExecutableFolder(std::string folder)
{
    SetFolder() = WithSeparator(std::move(folder));
}

} // namespace gw
