#pragma once

#include <string_view>

namespace gw {

/// The text of Page.css, which every page carries within.
extern const std::string_view kPageStyle;

} // namespace gw
