#pragma once

#include <string>

namespace gw {

/// Records the path of a file that must not outlive the process. Returns its number, or a negative number if
/// there are too many or the path is too long (the next sweep deletes such a file).
int AddLiveName(const std::string& path);
/// Forgets the path with this number; negative numbers are ignored.
void RemoveLiveName(int number);
/// Deletes the recorded files of this process. Signal handlers may call it.
void RemoveLiveFiles();
/// Makes the signals that end a process (SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE, SIGXCPU; on Windows what
/// ends a console's programs) delete the recorded files first. Signals that were ignored at process start
/// stay ignored.
void RemovePrivateFilesOnSignals();

} // namespace gw
