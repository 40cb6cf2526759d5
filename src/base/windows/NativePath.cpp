#include "NativePath.h"

#include "WindowsCalls.h"

namespace gw {

std::filesystem::path NativePath(std::string_view path)
{
    return {WideText(path)};
}

std::string PathText(const std::filesystem::path& path)
{
    return NarrowText(path.native());
}

} // namespace gw
