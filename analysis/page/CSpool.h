#pragma once

#include <cstdio>
#include <string>
#include <string_view>

namespace gw {

class CSafeFile;

/// Text kept in an unnamed temporary file (under TMPDIR) until the text before it is known, so that a page of
/// hundreds of motions does not need to fit into memory.
class CSpool
{
public:
    CSpool();
    ~CSpool();
    CSpool(const CSpool&) = delete;
    CSpool& operator=(const CSpool&) = delete;

    void Write(std::string_view text);
    /// Copies everything written. Returns false if reading or writing has failed at any time.
    bool CopyTo(CSafeFile& file);

private:
    std::FILE* m_pkFile; // null if the file could not be created
    int m_iError;        // why not; or why something could not be written
};

} // namespace gw
