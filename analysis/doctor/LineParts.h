#pragma once

#include <string_view>

namespace gw {

/// Removes and returns the next part of a hierarchy line, trimmed: a brace, or the words up to a brace that
/// is followed by nothing, another brace or a keyword. Empty at the end.
std::string_view NextPart(std::string_view& rest);

} // namespace gw
