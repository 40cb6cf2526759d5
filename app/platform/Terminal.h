#pragma once

#include <cstddef>
#include <cstdio>

namespace gw {

/// Returns whether a stream writes to a terminal that a person may look at.
bool IsTerminal(std::FILE* stream);
/// Returns whether a stream writes to a terminal that shows colors.
bool ShowsColors(std::FILE* stream);
/// Returns the width in characters of a stream's terminal; 80 if it is unknown.
size_t TerminalWidth(std::FILE* stream);

} // namespace gw
