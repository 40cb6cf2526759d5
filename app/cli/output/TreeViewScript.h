#pragma once

#include <string_view>

namespace gw {

/// The text of TreeView.js, which the tree page of an object dump needs next to it.
extern const std::string_view kTreeViewScript;

} // namespace gw
