#pragma once

namespace gw {

/// What joins the parts of a path, and all characters that separate them for the system.
inline constexpr char kPathSeparator = '\\';
inline constexpr const char* kSystemSeparators =
    "/\\:"; // "C:name" is a name in the current folder of a drive

} // namespace gw
