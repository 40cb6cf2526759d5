#include "CreatePrivateFolder.h"

#include "WindowsCalls.h"

namespace gw {

// The user's folder for temporary files is private already.
bool CreatePrivateFolder(const std::string& path)
{
    return CreateDirectoryW(WidePath(path).c_str(), nullptr) != 0;
}

} // namespace gw
