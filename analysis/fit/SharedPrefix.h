#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Returns the starts that all or nearly all names share, ignoring case, longest first: a namespace up to the
/// last colon, a prefix up to an underscore or dash, and the longest start of any kind.
std::vector<std::string> SharedPrefixes(std::span<const std::string> names);

/// Returns the longest start that all names share, ignoring case; empty without names.
std::string CommonStart(std::span<const std::string_view> names);

} // namespace gw
