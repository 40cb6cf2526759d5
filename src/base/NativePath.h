#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace gw {

/// Converts a path between UTF-8 and the standard library's class. Bytes that are not UTF-8 never throw: they
/// are kept where the system's paths are bytes, and replaced elsewhere.
std::filesystem::path NativePath(std::string_view path);
std::string PathText(const std::filesystem::path& path);

} // namespace gw
