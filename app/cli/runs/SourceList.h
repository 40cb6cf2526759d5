#pragma once

#include "COptions.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A source, and where it lies in what was named: its result lies there below the output folder.
struct CSource
{
    std::string path;
    std::string below; ///< "run/walk.bvh"; of a file that was named by itself its name
};

/// The sources that a command line names: files as they are, folders with all sources below them, and the
/// same for the lines of --files-from, which lie below the folder that they have in common. False, and says
/// why, when the list cannot be read.
bool ListSources(const COptions& options, std::span<const std::string_view> extensions,
                 std::vector<CSource>& sources);

/// The path of a source's result: below an output folder, or beside the source where there is none.
std::string OutputOf(const std::string& folder, const CSource& source, std::string_view extension);

} // namespace gw
