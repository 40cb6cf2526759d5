#pragma once

#include "ShellOptions.h"

namespace gw {

class CConversionPage;

/// Returns whether a page was requested.
inline bool IsPageAsked(const ShellOptions& options)
{
    return !options.html.empty() && !options.dryRun;
}

/// Checks that --html, if present, names a page that can be written; prints an error if not. A page must end
/// in .html or .htm, so that a typo cannot replace a motion, and an existing one requires --force.
EExit CheckPagePath(const ShellOptions& options);

/// Checks that the folder of the page exists, before a long run; prints an error if not.
bool HasPageFolder(const ShellOptions& options);

/// Writes the page atomically. Prints its path, or an error.
bool WritePage(const ShellOptions& options, CConversionPage& page);

} // namespace gw
