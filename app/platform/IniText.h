#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace gw {

// The INI dialect of Qt's settings, so that a program without Qt finds what one with it has stored. Sections
// and keys are written with %XX for what is no letter, digit, "_", "-" or "."; values with backslash escapes,
// in quotes where they hold ";", "," or "=". The section "General" is the part before the first section as
// well.

/// The value of a key, or none. Of equal keys the last counts. A list of values that somebody wrote without
/// quotes is one text with commas.
std::optional<std::string> FindIniValue(std::string_view text, std::string_view section,
                                        std::string_view key);

/// The text with a key set to a value; every other line stays as it was.
std::string SetIniValue(std::string_view text, std::string_view section, std::string_view key,
                        std::string_view value);

} // namespace gw
