#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace gw {

/// The folder that the text of a folder chooser names, with the platform's separators and one at its end.
/// Both separators are understood. An empty text names the folder that is open, a relative one begins there.
/// Nothing for a text with two separators in a row: that is no folder. What is named need not exist.
std::optional<std::string> FolderOfText(std::string text, const std::string& openFolder);

/// The same folder as a person reads it, without the separator at its end; a root keeps its own.
std::string_view FolderName(std::string_view folder);

} // namespace gw
