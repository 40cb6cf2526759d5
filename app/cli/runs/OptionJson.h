#pragma once

#include "ShellOptions.h"

#include <string>
#include <string_view>

namespace gw {

/// Returns the selected options (bits of EOption) that differ from their defaults, as a JSON object: the
/// option's first name, and its value.
std::string OptionsJson(const ShellOptions& options, uint64_t bits);

/// Restores options from such an object. Returns false, with the word that was not understood, for any other
/// text and for options outside `bits`.
bool ReadOptionsJson(std::string_view text, uint64_t bits, ShellOptions& options, std::string& wrong);

} // namespace gw
