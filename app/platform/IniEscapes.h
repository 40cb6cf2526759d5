#pragma once

#include <string>
#include <string_view>

namespace gw {

inline constexpr std::string_view kIniBlanks = " \t\r\n\v\f";

/// Decodes a key or section name: %XX and %UXXXX are code points, a backslash is a slash.
std::string UnescapedIniKey(std::string_view text);
/// Encodes a key. Names are ASCII.
std::string EscapedIniKey(std::string_view key);

/// Decodes a value: escapes and quotes are resolved, list elements are trimmed and joined by commas.
std::string UnescapedIniValue(std::string_view text);
/// Encodes a value, quoted if necessary.
std::string EscapedIniValue(std::string_view value);

} // namespace gw
