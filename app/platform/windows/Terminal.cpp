#include "Terminal.h"

#include "WindowsCalls.h"

#include <io.h>

namespace gw {

namespace {

// The C library calls every device a terminal, even NUL; only consoles have a mode.
bool ConsoleMode(std::FILE* stream, DWORD& mode)
{
    const auto console = reinterpret_cast<HANDLE>(_get_osfhandle(_fileno(stream)));
    return GetConsoleMode(console, &mode) != 0;
}

} // namespace

bool IsTerminal(std::FILE* stream)
{
    DWORD mode = 0;
    return ConsoleMode(stream, mode);
}

// PrepareStandardStreams has asked the console for it.
bool ShowsColors(std::FILE* stream)
{
    DWORD mode = 0;
    return ConsoleMode(stream, mode) && (mode & ENABLE_VIRTUAL_TERMINAL_PROCESSING) != 0;
}

size_t TerminalWidth(std::FILE* stream)
{
    constexpr size_t kUsualWidth = 80;
    CONSOLE_SCREEN_BUFFER_INFO screen = {};
    const auto console = reinterpret_cast<HANDLE>(_get_osfhandle(_fileno(stream)));
    if (!GetConsoleScreenBufferInfo(console, &screen) || screen.srWindow.Right < screen.srWindow.Left)
        return kUsualWidth;
    return static_cast<size_t>(screen.srWindow.Right - screen.srWindow.Left) + 1;
}

} // namespace gw
