#pragma once

#include <string>

namespace gw {

/// Returns the program's man page, in man(7) format: every command and option of the tables.
std::string ManPage();

} // namespace gw
