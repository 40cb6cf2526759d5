#include "Color.h"

#include <cstdlib>

#include <unistd.h>

namespace gw {

namespace {

std::string_view Variable(const char* name)
{
    const char* const value = std::getenv(name);
    return value ? value : "";
}

} // namespace

std::string Colored(std::FILE* stream, EColor color, std::string_view text)
{
    const std::string_view terminal = Variable("TERM");
    if (isatty(fileno(stream)) == 0 || !Variable("NO_COLOR").empty() || terminal.empty() ||
        terminal == "dumb")
        return std::string(text);
    const std::string start = color == EColor::Red ? "\x1b[31m" : "\x1b[33m";
    return start + std::string(text) + "\x1b[0m";
}

} // namespace gw
