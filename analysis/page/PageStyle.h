#pragma once

#include <string_view>

namespace gw {

/// The style sheet of the pages.
extern const std::string_view kPageStyle;
/// The script of the table of a page about many conversions.
extern const std::string_view kTableScript;
/// The script that plays both figures of a page about one conversion.
extern const std::string_view kPlayerScript;

} // namespace gw
