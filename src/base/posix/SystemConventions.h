#pragma once

#include <string_view>

namespace gw {

/// Joins the parts of a path.
inline constexpr char kPathSeparator = '/';
/// All characters that end a folder's name in a path.
inline constexpr std::string_view kSystemSeparators = "/";
/// Ends the lines of text files.
inline constexpr std::string_view kLineEnd = "\n";

} // namespace gw
