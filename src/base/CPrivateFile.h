#pragma once

#include "Files.h"

#include <string>
#include <string_view>

namespace gw {

/// A temporary file with a private name in a given folder. It is deleted with the object, and also when a
/// signal ends the program (RemovePrivateFilesOnSignals). While the object exists the file is locked, so that
/// no other program deletes it as a leftover (see PrivateNames.cpp).
class CPrivateFile
{
public:
    CPrivateFile() = default;
    /// Creates an empty file, readable only by the user, in the folder of a path. Path is empty if that
    /// fails.
    CPrivateFile(const std::string& besidePath, std::string_view extension);
    ~CPrivateFile();
    CPrivateFile(const CPrivateFile&) = delete;
    CPrivateFile& operator=(const CPrivateFile&) = delete;

    /// Replaces the file by a new, empty one in a folder that ends in a separator, with an extension (dot
    /// included) and a mode (minus the user's umask). Returns false if the file cannot be created.
    bool Create(const std::string& folder, std::string_view extension, unsigned mode);
    /// Same in the folder for temporary files, readable only by the user.
    bool CreateTemporary(std::string_view extension);
    /// Replaces the content; false if it cannot be written.
    bool Write(std::string_view text);
    /// Closes and deletes the file.
    void Remove();
    /// Closes the file without deleting it, because it has been renamed.
    void Release();

    /// Returns the path, or an empty text without a file.
    const std::string& Path() const { return m_kPath; }
    /// Returns the descriptor, open for reading and writing, or a negative number without a file.
    int File() const { return m_iFile; }

private:
    std::string m_kPath;
    int m_iFile = -1;
    int m_iLiveName = -1; // number of the path in LiveNames
};

} // namespace gw
