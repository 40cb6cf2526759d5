#pragma once

#include "ShellOptions.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A source and its relative path, which its result keeps below the output folder.
struct RunSource
{
    std::string path;
    std::string below; ///< such as "run/walk.bvh"; only the name for a file named directly
};

/// Lists the sources named on a command line: files as they are, folders with all sources below them. The
/// lines of --files-from are treated the same; their paths are relative to their common folder. Returns
/// false, after printing the reason, if the list cannot be read.
bool ListSources(const ShellOptions& options, std::span<const std::string_view> extensions,
                 std::vector<RunSource>& sources);

/// Returns the path of a source's result: below an output folder, or next to the source if `folder` is empty.
std::string OutputOf(const std::string& folder, const RunSource& source, std::string_view extension);

} // namespace gw
