#include "LinkNames.h"

#include "Paths.h"
#include "Text.h"

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <system_error>

#include <fcntl.h>
#include <unistd.h>

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
    return name.substr(name.find_last_of(kSeparators) + 1); // npos + 1 is 0
}

// A name of the file in a folder, with this platform's separators. One that leads out of the folder, whatever
// way it takes, is that of another machine: its last part is what can be looked for here.
std::string Join(const std::string& folder, std::string_view name)
{
    std::string path(name);
    std::ranges::replace(path, '\\', kPathSeparator);
    const fs::path normal = fs::path(path).lexically_normal(); // one file, one text
    path = !normal.empty() && *normal.begin() == ".." ? LastPart(name) : normal.string();
    return folder.empty() ? path : folder + kPathSeparator + path;
}

// A path without . and .. parts if it still is the same file: one file, one text. After a linked folder, ..
// leads elsewhere.
std::string ShortestPath(const std::string& path)
{
    std::error_code error;
    const std::string normal = fs::path(path).lexically_normal().string();
    return fs::equivalent(normal, path, error) ? normal : path;
}

fs::path Normal(const std::string& path)
{
    std::error_code error;
    return fs::absolute(path.empty() ? "." : path, error).lexically_normal();
}

// The path below a folder with / between its parts, or nothing where it does not lie there.
std::string BelowFolder(const std::string& folder, const std::string& path)
{
    const std::string below = Normal(path).lexically_relative(Normal(folder) / "").string();
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
    const bool isForeign = IsFromRoot(path) && !path.starts_with('/'); // a path of another system
    std::string below = isForeign ? path : BelowFolder(folder, path);
    const bool isDeep = below.find('/') != below.npos;
    // What the reader would take apart otherwise is better told from the root.
    if (below.empty() || below.find('\\') != below.npos || (isDeep && below.find(':') != below.npos))
        return isForeign ? path : Normal(path).string();
    if (!isDeep)
        return below;
    std::ranges::replace(below, '/', '\\');
    return ".\\" + below; // the reader drops the first part
}

void NoteFailedLink(const std::string& folder, std::string_view objectName, const std::string& path)
{
    // Root may write everywhere, also where nobody is meant to.
    if (IsReadOnly(folder.empty() ? "." : folder))
        return;
    const std::string name = Join(folder, "ImageLoadFailed.txt");
    // A folder may come from anywhere: nothing is written through a link, and no pipe is waited for.
    const int file =
        open(name.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC, 0666);
    if (file < 0)
        return;
    const std::string text =
        "LinkFileName = " + Printable(objectName) + "\nLocalLinkFileName = " + Printable(path) + '\n';
    [[maybe_unused]] const ssize_t written = write(file, text.data(), text.size());
    close(file);
}

} // namespace gw
