#pragma once

#include <string>
#include <string_view>

namespace gw {

inline constexpr std::string_view kIniBlanks = " \t\r\n\v\f";

/// A key or section name as it is meant: %XX and %UXXXX are code points, a backslash is a slash.
std::string UnescapedIniKey(std::string_view text);
/// The same as it is written. Names are ASCII.
std::string EscapedIniKey(std::string_view key);

/// A value as it is meant: escapes and quotes resolved, list elements trimmed and joined by commas.
std::string UnescapedIniValue(std::string_view text);
/// A value as it is written, in quotes where it needs them.
std::string EscapedIniValue(std::string_view value);

} // namespace gw
