#pragma once

#include "Files.h"

#include <string>

namespace gw {

/// A folder's files by their names. Where the system can, it resolves the folder's path once, not for every
/// file.
class CFolderFiles
{
public:
    explicit CFolderFiles(const std::string& folder);
    ~CFolderFiles();
    CFolderFiles(const CFolderFiles&) = delete;
    CFolderFiles& operator=(const CFolderFiles&) = delete;

    /// Gets the status of a file, following links; false if it does not exist.
    bool StatusOf(const char* name, FileStatus& status) const;

private:
    std::string m_kFolder; // where paths are resolved each time
    int m_iFile = -1;      // elsewhere
};

} // namespace gw
