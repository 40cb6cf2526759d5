#pragma once

#include "ShellOptions.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A source, and where it lies in what was named: its result lies there below the output folder.
struct RunSource
{
    std::string path;
    std::string below; ///< "run/walk.bvh"; of a file that was named by itself its name
};

/// The sources that a command line names: files as they are, folders with all sources below them, and the
/// same for the lines of --files-from, which lie below the folder that they have in common. False, and says
/// why, when the list cannot be read.
bool ListSources(const ShellOptions& options, std::span<const std::string_view> extensions,
                 std::vector<RunSource>& sources);

/// The path of a source's result: below an output folder, or beside the source where there is none.
std::string OutputOf(const std::string& folder, const RunSource& source, std::string_view extension);

} // namespace gw
