#pragma once

#include "ShellOptions.h"

#include <string>
#include <string_view>

namespace gw {

/// Returns the options selected by `bits` (of EOption) that differ from their defaults, as a JSON object that
/// maps each option's first name to its value.
std::string OptionsJson(const ShellOptions& options, uint64_t bits);

/// Restores options from such an object. Returns false for any other text and for options outside `bits`;
/// `wrong` is then the word that was not understood.
bool ReadOptionsJson(std::string_view text, uint64_t bits, ShellOptions& options, std::string& wrong);

} // namespace gw
