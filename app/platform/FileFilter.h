#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// One entry of a file dialog's filter.
struct FileFilter
{
    std::string text;                  ///< as shown to the user
    std::vector<std::string> patterns; ///< "*.bvh"
};

/// Splits a filter in the form of FileDialogSetup: pairs of text and patterns, each followed by "|", with
/// ";" between a choice's patterns. An incomplete last pair is ignored.
std::vector<FileFilter> SplitFilter(std::string_view filter);

} // namespace gw
