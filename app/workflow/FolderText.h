#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace gw {

/// Returns the folder for the text of a folder chooser, with the platform's separators and a trailing one.
/// Accepts both separators. An empty text means the open folder, and a relative one is resolved against it.
/// Nothing for a text with two consecutive separators. The folder need not exist.
std::optional<std::string> FolderOfText(std::string text, const std::string& openFolder);

/// Returns the folder for display, without the trailing separator; a root keeps its own.
std::string_view FolderName(std::string_view folder);

} // namespace gw
