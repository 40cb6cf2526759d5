#pragma once

#include <QStringList>
#include <string>

namespace gw {

/// What the desktop program was started for.
struct DesktopArguments
{
    bool mapTool = false;
    bool resetCounter = false;
    bool help = false;
    std::string file; ///< to be opened, or empty
};

/// Reads the arguments behind the program's name. A flag is what begins with a minus sign, or with a slash
/// where no file of that name is there; unknown flags are passed over.
DesktopArguments ReadArguments(const QStringList& arguments);

} // namespace gw
