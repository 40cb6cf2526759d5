#include "NativePath.h"

namespace gw {

std::filesystem::path NativePath(std::string_view path)
{
    return {path};
}

std::string PathText(const std::filesystem::path& path)
{
    return path.native();
}

} // namespace gw
