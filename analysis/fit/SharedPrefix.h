#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The starts that all or nearly all names share without regard to case, the longest first: a namespace up to
/// the last colon, a prefix up to an underscore or a dash, and the longest start of any kind.
std::vector<std::string> SharedPrefixes(std::span<const std::string> names);

/// The longest start that all names share without regard to case; empty for no names.
std::string CommonStart(std::span<const std::string_view> names);

} // namespace gw
