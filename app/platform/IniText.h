#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace gw {

// The INI dialect of Qt's settings, so that a program without Qt finds what a program with it has stored. In
// sections and keys, everything except letters, digits, "_", "-" and "." is written as %XX. Values use
// backslash escapes, and quotes if they contain ";", "," or "=". The section "General" also includes the part
// before the first section.

/// Returns the value of a key, or nothing; the last of equal keys counts. An unquoted list is returned as one
/// text with commas.
std::optional<std::string> FindIniValue(std::string_view text, std::string_view section,
                                        std::string_view key);

/// Returns the text with a key set to a value; other lines do not change.
std::string SetIniValue(std::string_view text, std::string_view section, std::string_view key,
                        std::string_view value);

} // namespace gw
