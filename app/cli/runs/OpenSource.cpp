#include "OpenSource.h"

#include "Words.h"

namespace gw {

bool OpenSource(CSourceFile& source, const std::string& path, EPackage package)
{
    const bool isOpen = source.Open(path, package);
    if (!isOpen)
        SayError(source.Failure().path, source.Failure().code.c_str(), source.Failure().words);
    return isOpen;
}

} // namespace gw
