#pragma once

#include <string>

namespace gw {

struct Notice;

/// Returns what notices with the same code have in common, as one line without names: "no installed profile
/// fits". For a code that has no such line, returns the first line of the notice itself.
std::string KindWords(const Notice& notice);

} // namespace gw
