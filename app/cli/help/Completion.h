#pragma once

#include <string>

namespace gw {

// Generate the completion scripts, which contain the program's commands, their options and the options'
// values, all from the tables.
std::string BashCompletion();
std::string FishCompletion();
std::string ZshCompletion();

} // namespace gw
