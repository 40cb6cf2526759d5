#pragma once

#include <string>

namespace gw {

/// The program's man page, in the language of man(7): every command and option of the tables.
std::string ManPage();

} // namespace gw
