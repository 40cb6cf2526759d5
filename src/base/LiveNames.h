#pragma once

#include <string>

namespace gw {

/// Records the path of a file that must not outlive the process. Returns its number; below 0 when there are
/// too many or the path is too long (such a file is left to the next sweep).
int AddLiveName(const std::string& path);
/// Forgets the path of such a number; a number below 0 is ignored.
void RemoveLiveName(int number);
/// From now on the signals that ask a process to end (SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE, SIGXCPU)
/// delete the recorded files first. Signals that the process was started to ignore stay ignored.
void RemovePrivateFilesOnSignals();

} // namespace gw
