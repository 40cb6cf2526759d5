#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The most characters that a display name may have.
inline constexpr size_t kProfileNameLimit = 64;

/// The first so many characters of a UTF-8 text.
std::string_view FirstCharacters(std::string_view text, size_t count);

/// The name that a profile takes when it may not be written over: "P" becomes "P(1)", "P(1)" becomes "P(2)",
/// until no other name in use equals it. A name that is not in use stays as it is, as does every name where
/// `inUse` is null.
std::string NextFreeName(std::string_view name, const std::vector<std::string>* inUse);

/// Whether a name equals one in use without regard to case and to blanks at the end. Null holds no names.
bool IsNameInUse(std::string_view name, const std::vector<std::string>* inUse);

} // namespace gw
