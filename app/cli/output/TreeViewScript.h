#pragma once

#include <string_view>

namespace gw {

/// The text of TreeView.js, which the tree page of an object dump wants beside it.
extern const std::string_view kTreeViewScript;

} // namespace gw
