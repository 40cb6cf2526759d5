#pragma once

#include <string_view>

namespace gw {

/// Takes the next part off a line of a hierarchy, without blanks around it: a brace, or the words up to a
/// brace that has nothing, another brace or a keyword behind it. Empty when none is left.
std::string_view NextPart(std::string_view& rest);

} // namespace gw
