#pragma once

#include <cstdint>
#include <string_view>

namespace gw {

/// Returns the three-letter language code for the maker's web page by locale number; "enu" for all others.
std::string_view LanguageCode(uint32_t locale);

/// Returns the locale number of a POSIX locale name ("de_DE.UTF-8") if its language has a code; otherwise 0.
uint32_t LocaleOfName(std::string_view posixName);

} // namespace gw
