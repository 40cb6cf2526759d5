#include "CInterrupt.h"

#include "WindowsCalls.h"

#include <atomic>

namespace gw {

namespace {

constexpr DWORD kLongerThanTheSystemWaits = 60'000;

std::atomic<int> requests = 0;

// Runs in a thread of its own. When the console closes or the session ends, the system ends the process as
// soon as this returns, and after some seconds in any case: that counts as an urgent request.
BOOL WINAPI TakeRequest(DWORD kind)
{
    const bool isUrgent = kind != CTRL_C_EVENT && kind != CTRL_BREAK_EVENT;
    requests += isUrgent ? 2 : 1;
    if (isUrgent)
        Sleep(kLongerThanTheSystemWaits);
    return TRUE;
}

BOOL WINAPI IgnoreRequest(DWORD)
{
    return TRUE;
}

} // namespace

// The system keeps a list of handlers; the last one is asked first.
struct CInterrupt::Before
{
};

CInterrupt::CInterrupt()
{
    requests = 0;
    SetConsoleCtrlHandler(TakeRequest, TRUE);
}

CInterrupt::~CInterrupt()
{
    SetConsoleCtrlHandler(TakeRequest, FALSE);
}

int CInterrupt::Count() const
{
    return requests;
}

void CInterrupt::Ignore()
{
    SetConsoleCtrlHandler(IgnoreRequest, TRUE);
}

} // namespace gw
