#include "CreatePrivateFolder.h"

#include <sys/stat.h>

namespace gw {

bool CreatePrivateFolder(const std::string& path)
{
    return mkdir(path.c_str(), S_IRWXU) == 0;
}

} // namespace gw
