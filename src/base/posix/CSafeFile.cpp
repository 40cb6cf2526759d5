#include "CSafeFile.h"

namespace gw {

namespace {

ssize_t WriteSafely(void* file, const char* text, size_t size)
{
    const bool isWritten = static_cast<CSafeFile*>(file)->Write(std::string_view(text, size));
    return isWritten ? static_cast<ssize_t>(size) : 0;
}

} // namespace

std::FILE* TextStreamTo(CSafeFile& file)
{
    return fopencookie(&file, "w",
                       {.read = nullptr, .write = WriteSafely, .seek = nullptr, .close = nullptr});
}

} // namespace gw
