#pragma once

#include "SystemConventions.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The parts of a path. Both separators are accepted; joining uses the platform's.
struct PathParts
{
    std::string folder;    ///< drive and directory with the trailing separator, or empty
    std::string stem;      ///< file name without extension
    std::string extension; ///< from the last dot (included), or empty
};

PathParts SplitPath(std::string_view path);
/// Returns whether a path has this extension (dot included), ignoring case.
bool HasExtension(std::string_view path, std::string_view extension);
/// Returns a folder with a trailing separator; empty stays empty.
std::string WithSeparator(std::string folder);

/// Returns whether a file exists. Paths are UTF-8. File system errors count as "no".
bool FileExists(const std::string& path);
bool FolderExists(const std::string& path);
/// Returns whether two paths refer to the same existing file.
bool IsSameFile(const std::string& a, const std::string& b);
/// Returns whether a path is a symbolic link, whatever it points to.
bool IsLink(const std::string& path);
/// Returns whether a path is a folder itself, not a link to one.
bool IsFolderItself(const std::string& path);
/// Stores the size of a regular file in bytes; false if the file does not exist or cannot be examined.
bool FileSize(const std::string& path, uint64_t& byteCount);
/// Returns whether a file exists and is read-only: without a write bit in its mode, or with the read-only
/// attribute; or not writable by the user. LastSystemError then has the reason.
bool IsReadOnly(const std::string& path);
/// Creates a folder and its parents; succeeds if it exists.
bool CreateFolder(const std::string& path);
bool DeleteFile(const std::string& path);

/// Returns the folder of a path with its separator, or empty if the path has none. Unlike SplitPath, accepts
/// only the separators that the system does.
std::string FolderOf(const std::string& path);
/// Returns the names of a folder's regular files with this extension (dot included, case ignored), sorted by
/// name so that runs are the same everywhere; empty if the folder cannot be read. Private files are skipped.
std::vector<std::string> FilesInFolder(const std::string& folder, std::string_view extension);

/// Returns the end of a chain of symbolic links, whether or not a file exists there. Empty for a cycle.
std::string FollowLinks(const std::string& path);
/// Resolves a relative path, with its "..", against a folder that contains no links.
std::string PathFrom(const std::string& folder, const std::string& relative);
/// Returns the system's folder for temporary files with a trailing separator; empty if it does not exist.
std::string TemporaryFolder();
/// Returns the folder of the running program with a trailing separator, after following links to the program.
std::string ProgramFolder();
/// Returns the folder that the program's modules and data are found from: ProgramFolder, or the one that was
/// set.
std::string ExecutableFolder();
/// Makes ExecutableFolder return another folder, for a library in a foreign program. Call it before any
/// thread starts.
void SetExecutableFolder(std::string folder);

} // namespace gw
