#pragma once

#include "Notice.h"

#include <string>

namespace gw {

struct ShellOptions;

/// Returns a path as a word of a command line: as it is, or quoted if a shell would change it. Safe to print.
std::string ShellWord(const std::string& path);

/// Returns a notice about a source with the command or the option that helps, if there is one that the
/// command line does not have yet.
Notice WithHelp(const ShellOptions& options, Notice notice);

/// Returns whether WithHelp found that --mend can repair the source.
bool NamesMending(const Notice& notice);

} // namespace gw
