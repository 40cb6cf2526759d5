#pragma once

#include <string>
#include <string_view>

namespace gw {

/// The path that a stored link name means for a container in a folder. A relative name loses what stands
/// before its first separator, on purpose, and never leads out of the folder; a name with a drive or from a
/// root stays where such a file is, and otherwise its last part is looked for in the folder. Both separators
/// count. An empty folder is the current one.
std::string ResolveLinkName(const std::string& folder, std::string_view name);

/// The name that a container in a folder stores for a path, so that ResolveLinkName finds it again: relative
/// where the file lies in the folder or below it, else as it is, from the root.
std::string StoredLinkName(const std::string& folder, const std::string& path);

/// Leaves a note in the folder that a linked picture could not be read. Where nothing can be written, nothing
/// happens.
void NoteFailedLink(const std::string& folder, std::string_view objectName, const std::string& path);

} // namespace gw
