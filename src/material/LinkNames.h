#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Resolves a stored link name for a container in a folder. A relative name loses everything before its first
/// separator, on purpose, and never leaves the folder. A name with a drive or a root is used if the file
/// exists, otherwise its last part is looked up in the folder. Both separators are accepted. An empty folder
/// is the current one.
std::string ResolveLinkName(const std::string& folder, std::string_view name);

/// Returns the name under which a container in a folder stores a path, so that ResolveLinkName finds it
/// again: relative if the file is in or below the folder, otherwise as it is, from the root.
std::string StoredLinkName(const std::string& folder, const std::string& path);

/// Writes a note into the folder that a linked picture could not be read. Ignores write errors.
void NoteFailedLink(const std::string& folder, std::string_view objectName, const std::string& path);

} // namespace gw
