#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The maximum length of a display name, in characters.
inline constexpr size_t kProfileNameLimit = 64;

/// Returns the first `count` characters of a UTF-8 text.
std::string_view FirstCharacters(std::string_view text, size_t count);

/// Returns a new name for a profile that must not be overwritten: "P" becomes "P(1)", "P(1)" becomes "P(2)",
/// until no name in use is equal. A name that is not in use stays as it is, as does any name if `inUse` is
/// null.
std::string NextFreeName(std::string_view name, const std::vector<std::string>* inUse);

/// Returns whether a name equals one in use, ignoring case and trailing blanks. Null contains no names.
bool IsNameInUse(std::string_view name, const std::vector<std::string>* inUse);

} // namespace gw
