#include "CMappedFile.h"

namespace gw {

// No other program could replace or cut a mapped file, so even a large one is read.
EFailure CMappedFile::Map(int file, size_t size)
{
    return Read(file, size);
}

void CMappedFile::Unmap() {}

bool CMappedFile::IsWhole() const
{
    return true;
}

void CMappedFile::Forget(size_t) {}

} // namespace gw
