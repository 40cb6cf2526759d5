#pragma once

#include <string_view>

namespace gw {

/// The text of Page.css, which is embedded in every page.
extern const std::string_view kPageStyle;

} // namespace gw
