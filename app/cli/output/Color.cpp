#include "Color.h"

#include "Processes.h"
#include "Terminal.h"

namespace gw {

std::string Colored(std::FILE* stream, EColor color, std::string_view text)
{
    if (!ShowsColors(stream) || !EnvironmentVariable("NO_COLOR").empty())
        return std::string(text);
    const std::string start = color == EColor::Red ? "\x1b[31m" : "\x1b[33m";
    return start + std::string(text) + "\x1b[0m";
}

} // namespace gw
