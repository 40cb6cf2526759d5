#include "CSafeFile.h"

#include "WindowsCalls.h"

namespace gw {

std::FILE* TextStreamTo(CSafeFile& file)
{
    return _wfopen(WidePath(file.PrivatePath()).c_str(), L"r+tN");
}

} // namespace gw
