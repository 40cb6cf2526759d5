#pragma once

#include <QStringList>
#include <string>

namespace gw {

/// The parsed arguments of the desktop program.
struct DesktopArguments
{
    bool mapTool = false;
    bool resetCounter = false;
    bool help = false;
    std::string file; ///< the file to open, or empty
};

/// Parses the arguments after the program's name. A flag starts with a minus sign, or with a slash if no file
/// has that name; unknown flags are ignored.
DesktopArguments ReadArguments(const QStringList& arguments);

} // namespace gw
