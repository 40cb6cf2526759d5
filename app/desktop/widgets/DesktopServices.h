#pragma once

#include <string>

namespace gw {

// Opens things in other programs of the desktop. None of these functions waits for them.

/// Shows a file in its folder, selected if the file manager supports that.
void ShowInFileManager(const std::string& path);
/// Opens a help file. A topic after its path ("::topic") is ignored, because desktops have no common way to
/// pass one to a viewer.
void OpenHelpFile(const std::string& path);
/// Opens an address. Returns false if the desktop has no program for it.
bool OpenWebPage(const std::string& address);

} // namespace gw
