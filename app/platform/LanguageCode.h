#pragma once

#include <cstdint>
#include <string_view>

namespace gw {

/// The three-letter language code that the maker's web page takes, for a locale number; "enu" for all others.
std::string_view LanguageCode(uint32_t locale);

/// The locale number of a POSIX locale name ("de_DE.UTF-8"), for the languages that have a code of their own;
/// 0 for all others.
uint32_t LocaleOfName(std::string_view posixName);

} // namespace gw
