#pragma once

#include <string>

namespace gw {

// What the desktop around the program shows in programs of its own. None of these waits for them.

/// Shows a file in its folder: selected, where the desktop has a file manager that can, else the folder
/// alone.
void ShowInFileManager(const std::string& path);
/// Opens a help file. The topic that may stand behind its path, after "::", is left to the reader: desktops
/// have no common way to tell a viewer.
void OpenHelpFile(const std::string& path);
/// Opens an address. False where the desktop has nothing to open it with.
bool OpenWebPage(const std::string& address);

} // namespace gw
