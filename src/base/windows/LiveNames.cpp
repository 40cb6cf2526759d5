#include "LiveNames.h"

#include "WindowsCalls.h"

namespace gw {

namespace {

// Runs in a thread of its own. The handler that was there first then ends the process.
BOOL WINAPI EndByConsole(DWORD)
{
    RemoveLiveFiles();
    return FALSE;
}

} // namespace

void RemovePrivateFilesOnSignals()
{
    SetConsoleCtrlHandler(EndByConsole, TRUE);
}

} // namespace gw
