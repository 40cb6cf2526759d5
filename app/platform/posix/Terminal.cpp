#include "Terminal.h"

#include <cstdlib>
#include <string_view>

#include <sys/ioctl.h>
#include <unistd.h>

namespace gw {

bool IsTerminal(std::FILE* stream)
{
    return isatty(fileno(stream)) != 0;
}

bool ShowsColors(std::FILE* stream)
{
    const char* const value = std::getenv("TERM");
    const std::string_view terminal = value ? value : "";
    return IsTerminal(stream) && !terminal.empty() && terminal != "dumb";
}

size_t TerminalWidth(std::FILE* stream)
{
    constexpr size_t kUsualWidth = 80;
    winsize size = {};
    return ioctl(fileno(stream), TIOCGWINSZ, &size) == 0 && size.ws_col > 0 ? size.ws_col : kUsualWidth;
}

} // namespace gw
