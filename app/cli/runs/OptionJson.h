#pragma once

#include "ShellOptions.h"

#include <string>
#include <string_view>

namespace gw {

/// Those of some options (bits of EOption) that differ from what they are unless told, as a JSON object: the
/// option's first name, and its value.
std::string OptionsJson(const ShellOptions& options, uint64_t bits);

/// Takes such an object back into options. False, with the word that was not understood, for any other text
/// and for options other than those.
bool ReadOptionsJson(std::string_view text, uint64_t bits, ShellOptions& options, std::string& wrong);

} // namespace gw
