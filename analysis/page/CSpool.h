#pragma once

#include <cstdio>
#include <string>
#include <string_view>

namespace gw {

class CSafeFile;

/// Text that waits in a nameless temporary file (under TMPDIR) until what stands before it is known: a page
/// of hundreds of motions need not lie in memory.
class CSpool
{
public:
    CSpool();
    ~CSpool();
    CSpool(const CSpool&) = delete;
    CSpool& operator=(const CSpool&) = delete;

    void Write(std::string_view text);
    /// Copies all that was written. False when the file system failed on either side, now or before.
    bool CopyTo(CSafeFile& file);

private:
    std::FILE* m_pkFile; // null where there is no room for temporary files
};

} // namespace gw
