#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// One choice of a file dialog's filter.
struct FileFilter
{
    std::string text;                  ///< as the user reads it
    std::vector<std::string> patterns; ///< "*.bvh"
};

/// The choices of a filter as FileDialogSetup has it: pairs of text and patterns, "|" behind each; ";"
/// stands between the patterns of one choice. An unfinished pair at the end is left out.
std::vector<FileFilter> SplitFilter(std::string_view filter);

} // namespace gw
