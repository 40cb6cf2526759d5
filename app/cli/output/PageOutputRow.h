#pragma once

#include "PageRow.h"

#include <string>
#include <string_view>

namespace gw {

/// Returns a page's row about a source from its record, a line of JSON. `outcome` is the outcome in this run.
/// The record can be of an earlier run, or empty.
PageRow PageRowOf(const std::string& source, const char* outcome, std::string_view record);

} // namespace gw
