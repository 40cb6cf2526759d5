#pragma once

#include <string>

namespace gw {

/// Creates a folder that only the user can see into. Returns false if anything has the name, or if it cannot
/// be created; LastSystemError then has the reason.
bool CreatePrivateFolder(const std::string& path);

} // namespace gw
