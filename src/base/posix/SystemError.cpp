#include "SystemError.h"

#include <cerrno>
#include <system_error>

namespace gw {

int LastSystemError()
{
    return errno;
}

void ClearLastSystemError()
{
    errno = 0;
}

bool IsNameTaken(int code)
{
    return code == EEXIST;
}

bool IsNotFound(int code)
{
    return code == ENOENT;
}

bool IsOutOfMemory(int code)
{
    return code == ENOMEM;
}

std::string SystemErrorWords(int code)
{
    return code == 0 ? std::string() : ": " + std::generic_category().message(code);
}

} // namespace gw
