#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A path in its parts. Both separators are understood; what is joined uses the platform's.
struct PathParts
{
    std::string folder;    ///< drive and directory with the trailing separator, or empty
    std::string stem;      ///< file name without extension
    std::string extension; ///< from the last dot on, dot included, or empty
};

inline constexpr char kPathSeparator =
#ifdef _WIN32
    '\\';
#else
    '/';
#endif

PathParts SplitPath(std::string_view path);
/// Whether a path's extension, dot included, equals the one asked for without regard to case.
bool HasExtension(std::string_view path, std::string_view extension);
/// A folder with a separator at its end; empty stays empty.
std::string WithSeparator(std::string folder);

/// Paths are UTF-8. An error of the file system counts as "no".
bool FileExists(const std::string& path);
bool FolderExists(const std::string& path);
/// Whether a path is a symbolic link, wherever it leads.
bool IsLink(const std::string& path);
/// Whether a folder stands under a path itself, and no link that leads to one.
bool IsFolderItself(const std::string& path);
/// The size of a regular file in bytes; false when there is none or it cannot be examined.
bool FileSize(const std::string& path, uint64_t& byteCount);
/// Whether a file is there and read-only: no write bit in its mode, or not writable by the user.
bool IsReadOnly(const std::string& path);
/// Makes a folder with all above it; an existing one is no error.
bool CreateFolder(const std::string& path);
bool DeleteFile(const std::string& path);

/// The folder of a path with its separator; empty where none stands in it. Unlike in SplitPath, only the
/// platform's separator counts, as it does for the system.
std::string FolderOf(const std::string& path);
/// The names of all that is in a folder, in no order; none where it cannot be read.
std::vector<std::string> NamesInFolder(const std::string& folder);
/// The names of the regular files in a folder whose extension (dot included) fits without regard to case, in
/// name order, so that a run is the same everywhere. Private files are passed over.
std::vector<std::string> FilesInFolder(const std::string& folder, std::string_view extension);

/// A relative path seen from a folder without links, with its ".." carried out.
std::string PathFrom(const std::string& folder, const std::string& relative);
/// The folder of the running program with its trailing separator. Links to the program are followed.
std::string ExecutableFolder();

} // namespace gw
