#pragma once

#include "ShellOptions.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A source and its relative position, which its result keeps below the output folder.
struct RunSource
{
    std::string path;
    std::string below; ///< "run/walk.bvh"; for a file that was named directly, its name
};

/// Lists the sources named on a command line: files as they are, folders with all sources below them. The
/// same for the lines of --files-from, whose positions are relative to their common folder. If the list
/// cannot be read, prints why and returns false.
bool ListSources(const ShellOptions& options, std::span<const std::string_view> extensions,
                 std::vector<RunSource>& sources);

/// Returns the path of a source's result: below an output folder, or next to the source if `folder` is empty.
std::string OutputOf(const std::string& folder, const RunSource& source, std::string_view extension);

} // namespace gw
