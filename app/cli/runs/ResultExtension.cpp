#include "ResultExtension.h"

#include "Paths.h"
#include "ShellOptions.h"

namespace gw {

namespace {

// Formats of results other than .Kinetra.
constexpr std::string_view kExchanged[] = {".htr", ".bvh", ".glb"};

} // namespace

std::string_view ResultExtension(const ShellOptions& options)
{
    for (const std::string_view extension : kExchanged)
    {
        if (extension.substr(1) == options.format)
            return extension;
    }
    return ".Kinetra";
}

std::string_view ResultExtension(const ShellOptions& options, const std::string& output)
{
    for (const std::string_view extension : kExchanged)
    {
        if (options.format.empty() && HasExtension(output, extension))
            return extension;
    }
    return ResultExtension(options);
}

} // namespace gw
