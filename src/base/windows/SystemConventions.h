#pragma once

#include <string_view>

namespace gw {

/// Joins the parts of a path.
inline constexpr char kPathSeparator = '\\';
/// All characters that end a folder's name in a path.
inline constexpr std::string_view kSystemSeparators = "/\\:"; // "C:name" is in the current folder of a drive
/// Ends the lines of text files.
inline constexpr std::string_view kLineEnd = "\r\n";

} // namespace gw
