#pragma once

#include "ShellOptions.h"

namespace gw {

class CConversionPage;

/// Whether a page is to be written.
inline bool IsPageAsked(const ShellOptions& options)
{
    return !options.html.empty() && !options.dryRun;
}

/// Whether --html names a page that may be written; Done without one. Says what is wrong: a page ends in
/// .html or .htm, so that a slip replaces no motion, and one that exists wants --force.
EExit CheckPagePath(const ShellOptions& options);

/// Whether the folder of the page is there, so that nobody learns behind a long run that it is not. Says so.
bool HasPageFolder(const ShellOptions& options);

/// Writes the page in one step. Says where it is, or that it cannot be written.
bool WritePage(const ShellOptions& options, CConversionPage& page);

} // namespace gw
