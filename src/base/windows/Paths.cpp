#include "Paths.h"

#include "Files.h"
#include "SystemError.h"
#include "WindowsCalls.h"

namespace gw {

namespace {

constexpr size_t kLongestPath = 32768; // the system's limit, with the final 0

// Calls a function that fills a buffer and returns the length of its text.
template <typename Call>
std::wstring TextFrom(Call call)
{
    std::wstring text(kLongestPath, L'\0');
    const DWORD size = call(text.data(), static_cast<DWORD>(text.size()));
    text.resize(size < kLongestPath ? size : 0);
    return text;
}

// Full paths from the system have this prefix, which others need not accept.
std::string WithoutPrefix(std::wstring_view path)
{
    constexpr std::wstring_view kShare = L"\\\\?\\UNC\\";
    constexpr std::wstring_view kPrefix = L"\\\\?\\";
    if (path.starts_with(kShare))
        return "\\\\" + NarrowText(path.substr(kShare.size()));
    return NarrowText(path.starts_with(kPrefix) ? path.substr(kPrefix.size()) : path);
}

} // namespace

// The attribute, or a list of rights that lets this user not write. A folder's attribute means something
// else.
bool IsReadOnly(const std::string& path)
{
    const std::wstring wide = WidePath(path);
    const DWORD attributes = GetFileAttributesW(wide.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return false;
    const bool isFolder = (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
    if (!isFolder && (attributes & FILE_ATTRIBUTE_READONLY) != 0)
    {
        SetLastError(ERROR_ACCESS_DENIED);
        return true;
    }
    const CHandle file(CreateFileW(wide.c_str(), isFolder ? FILE_ADD_FILE : FILE_WRITE_DATA, kShareAll,
                                   nullptr, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr));
    return !file && GetLastError() == ERROR_ACCESS_DENIED;
}

bool CreateFolder(const std::string& path)
{
    const std::string bare = path.substr(0, path.find_last_not_of(kSystemSeparators) + 1);
    if (FolderExists(path))
        return true;
    if (CreateDirectoryW(WidePath(bare).c_str(), nullptr))
        return true;
    const std::string parent = FolderOf(bare);
    if (GetLastError() == ERROR_PATH_NOT_FOUND && parent.size() < bare.size() && !parent.empty() &&
        CreateFolder(parent) && CreateDirectoryW(WidePath(bare).c_str(), nullptr))
        return true;
    KeepSystemError();
    return FolderExists(path); // another program may have created it
}

std::string FollowLinks(const std::string& path)
{
    FileStatus status;
    if (!StatusOfLink(path, status) || status.kind != EFileKind::Link)
        return path;
    const CHandle file(CreateFileW(WidePath(path).c_str(), 0, kShareAll, nullptr, OPEN_EXISTING,
                                   FILE_FLAG_BACKUP_SEMANTICS, nullptr));
    if (!file) // a link to nothing: a new file replaces it
        return GetLastError() == ERROR_CANT_RESOLVE_FILENAME ? std::string() : path;
    const std::wstring target = TextFrom(
        [&](wchar_t* text, DWORD size) { return GetFinalPathNameByHandleW(file.Get(), text, size, 0); });
    return target.empty() ? path : WithoutPrefix(target);
}

std::string TemporaryFolder()
{
    const std::wstring folder = TextFrom([](wchar_t* text, DWORD size) { return GetTempPathW(size, text); });
    const std::string path = WithSeparator(NarrowText(folder));
    if (FolderExists(path))
        return path;
    KeepSystemError();
    return {};
}

std::string ProgramFolder()
{
    const std::wstring program =
        TextFrom([](wchar_t* text, DWORD size) { return GetModuleFileNameW(nullptr, text, size); });
    return SplitPath(FollowLinks(WithoutPrefix(program))).folder;
}

} // namespace gw
