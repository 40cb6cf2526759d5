#pragma once

#include <string>

namespace gw {

// The scripts that tell a shell the program's commands, their options and what may stand behind these, all
// from the tables.
std::string BashCompletion();
std::string FishCompletion();
std::string ZshCompletion();

} // namespace gw
