// File names inside containers come from other machines and possibly from an attacker. A relative name is
// kept within the container's folder, and an absolute one is tried and otherwise reduced to its last part.
// Names are stored relative if the file is below the folder, so that a scene can be moved with its pictures.

#include "LinkNames.h"

#include "Files.h"
#include "NativePath.h"
#include "Paths.h"
#include "SystemError.h"
#include "Text.h"

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <system_error>

namespace fs = std::filesystem;

namespace gw {

namespace {

constexpr std::string_view kSeparators = "/\\";

bool IsFromRoot(std::string_view name)
{
    return name.find(':') != name.npos || name.starts_with("\\\\") || name.starts_with('/');
}

bool IsRegularFile(const std::string& path)
{
    uint64_t byteCount = 0;
    return FileSize(path, byteCount);
}

std::string_view LastPart(std::string_view name)
{
    const std::string_view last = name.substr(name.find_last_of(kSeparators) + 1); // npos + 1 is 0
    return last.substr(last.find_last_of(kSystemSeparators) + 1);                  // without a drive
}

// Joins a folder and a file name, using this platform's separators. A name that leads outside the folder
// comes from another machine, so only its last part is used.
std::string Join(const std::string& folder, std::string_view name)
{
    std::string path(name);
    std::ranges::replace(path, '\\', kPathSeparator);
    const fs::path normal = NativePath(path).lexically_normal(); // one spelling per file
    path = !normal.empty() && *normal.begin() == ".." ? LastPart(name) : PathText(normal);
    return folder.empty() ? path : folder + kPathSeparator + path;
}

bool AreSameFile(const std::string& a, const std::string& b)
{
    FileStatus first, second;
    return StatusOf(a, first) && StatusOf(b, second) && first.device == second.device &&
           first.inode == second.inode;
}

// Returns a path without . and .. parts if it is still the same file, so each file has one spelling. After a
// linked folder, .. leads elsewhere.
std::string ShortestPath(const std::string& path)
{
    const std::string normal = PathText(NativePath(path).lexically_normal());
    return AreSameFile(normal, path) ? normal : path;
}

fs::path Normal(const std::string& path)
{
    std::error_code error;
    return fs::absolute(NativePath(path.empty() ? "." : path), error).lexically_normal();
}

// Returns the path below a folder with / separators, or nothing if it is not below it.
std::string BelowFolder(const std::string& folder, const std::string& path)
{
    std::string below = PathText(Normal(path).lexically_relative(Normal(folder) / ""));
    std::ranges::replace(below, kPathSeparator, '/');
    return below == "." || below == ".." || below.starts_with("../") ? std::string() : below;
}

} // namespace

std::string ResolveLinkName(const std::string& folder, std::string_view name)
{
    if (!IsFromRoot(name))
        return Join(folder, name.substr(name.find_first_of(kSeparators) + 1)); // npos + 1 is 0
    if (IsRegularFile(std::string(name)))
        return ShortestPath(std::string(name));
    return Join(folder, LastPart(name));
}

std::string StoredLinkName(const std::string& folder, const std::string& path)
{
    if (IsFromRoot(path) && !NativePath(path).is_absolute())
        return path; // of another system
    std::string below = BelowFolder(folder, path);
    const bool isDeep = below.find('/') != below.npos;
    // If the reader would split the name differently, store the full path instead.
    if (below.empty() || below.find('\\') != below.npos || (isDeep && below.find(':') != below.npos))
        return PathText(Normal(path));
    if (!isDeep)
        return below;
    std::ranges::replace(below, '/', '\\');
    return ".\\" + below; // the reader drops the first part
}

void NoteFailedLink(const std::string& folder, std::string_view objectName, const std::string& path)
{
    // Root can write everywhere, even where nobody should.
    if (IsReadOnly(folder.empty() ? "." : folder))
        return;
    const std::string name = Join(folder, "ImageLoadFailed.txt");
    // The folder can be anybody's: do not write through a link or wait for a pipe.
    const int file = OpenFile(name, EOpen::Overwrite);
    if (file < 0)
        return;
    std::string text = "LinkFileName = " + Printable(objectName);
    text.append(kLineEnd).append("LocalLinkFileName = ").append(Printable(path)).append(kLineEnd);
    if (!WriteAll(file, text))
        ForgetSystemError();
    CloseFile(file);
}

} // namespace gw
