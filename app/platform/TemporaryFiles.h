#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Creates an empty file, readable only by the user, in the folder for temporary files; its name is new and
/// ends in an extension. Returns its path, or an empty text after keeping the reason (KeepSystemError).
std::string CreateTemporaryFile(std::string_view extension);
/// Same for a folder; `purpose` is part of its name. The path has a trailing separator.
std::string CreateTemporaryFolder(std::string_view purpose);

} // namespace gw
