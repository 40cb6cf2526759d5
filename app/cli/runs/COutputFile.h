#pragma once

#include "Notice.h"

#include <string>
#include <string_view>

namespace gw {

struct ShellOptions;

/// Where a command writes a result: the named file, or a temporary one whose content then goes to standard
/// output, a pipe or a device.
class COutputFile
{
public:
    COutputFile() = default;
    ~COutputFile() { Remove(); }
    COutputFile(const COutputFile&) = delete;
    COutputFile& operator=(const COutputFile&) = delete;

    /// Returns false, after printing the reason, if the output may not be written. `extension` is that of the
    /// temporary file, dot included.
    bool Open(const ShellOptions& options, const std::string& path, std::string_view extension);
    /// Same without a check whether a file may be replaced; the reason goes to Failure().
    bool Open(const std::string& path, std::string_view extension);

    /// Returns the file to write.
    const std::string& Path() const { return m_kCopy.empty() ? m_kPath : m_kCopy; }
    /// Sends a temporary file on its way. Returns false, with the reason in Failure(), if that fails.
    bool Deliver();
    /// Same, but prints the reason.
    bool DeliverOrSay();
    const Notice& Failure() const { return m_kFailure; }

private:
    bool Create(std::string_view extension);
    void Remove();
    bool Fail(const std::string& words);

    std::string m_kPath;
    std::string m_kCopy; ///< the temporary file; empty if the named file is written
    int m_iLiveName = -1;
    Notice m_kFailure;
};

} // namespace gw
