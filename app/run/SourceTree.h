#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The files that a walk through a folder found.
struct SourceFolder
{
    std::vector<std::string> files;      ///< below the folder: "b/walk.bvh"
    std::vector<std::string> unreadable; ///< folders below it that could not be read
};

/// All regular files below a folder whose extension is one of some, dots included and without regard to case.
/// Of each folder first its own files, by extension and then by name, then its folders by name. Every folder
/// is taken once, wherever links lead; one is left out with all below it, unless it is the walked one itself:
/// where the results go.
SourceFolder WalkFolder(const std::string& folder, std::span<const std::string_view> extensions,
                        const std::string& leftOut);

} // namespace gw
