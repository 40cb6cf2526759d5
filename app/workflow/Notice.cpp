#include "Notice.h"

#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

bool IsBinary(const std::string& path)
{
    constexpr std::string_view kExtensions[] = {".orn", ".kinetra", ".chb"};
    return std::ranges::any_of(kExtensions, [&](std::string_view e) { return HasExtension(path, e); });
}

Notice MakeNotice(const std::string& path, const char* code, const std::string& words, ESeverity severity)
{
    return {severity, path, 0, code, {}, words};
}

std::string NoticeLine(const Notice& notice)
{
    std::string line = Printable(notice.path);
    if (notice.where != 0)
        line += (IsBinary(notice.path) ? ": byte " : ":") + std::to_string(notice.where);
    return (line.empty() ? line : line + ": ") + notice.words;
}

} // namespace gw
