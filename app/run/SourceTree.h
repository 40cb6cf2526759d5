#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The files found below a folder.
struct SourceFolder
{
    std::vector<std::string> files;      ///< relative to the folder: "b/walk.bvh"
    std::vector<std::string> unreadable; ///< subfolders that could not be read
    /// links to nothing, relative to the folder: those with one of the extensions, and those without any,
    /// which may have been folders
    std::vector<std::string> deadLinks;
};

/// Returns all regular files below a folder with one of these extensions (dots included, case ignored),
/// except hidden files and those in hidden folders, whose names begin with a dot. Each folder's own files
/// come first, by extension and then by name, followed by its subfolders by name. Every folder is visited
/// once, whatever links exist. One folder, where the results go, is skipped with its subtree, unless it is
/// the root.
SourceFolder WalkFolder(const std::string& folder, std::span<const std::string_view> extensions,
                        const std::string& leftOut);

} // namespace gw
