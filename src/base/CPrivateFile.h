#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// A file with a private name in some folder, for what is being written or is needed for a moment only. It is
/// removed with the object, and when a signal ends the program (RemovePrivateFilesOnSignals). While the
/// object lives the file is locked, so that no other program takes it for a leftover (PrivateNames.cpp).
class CPrivateFile
{
public:
    CPrivateFile() = default;
    /// Creates an empty file beside a path that only the user may read; see Path for success.
    CPrivateFile(const std::string& besidePath, std::string_view extension);
    ~CPrivateFile();
    CPrivateFile(const CPrivateFile&) = delete;
    CPrivateFile& operator=(const CPrivateFile&) = delete;

    /// Replaces the file by a new, empty one in a folder that ends in a separator, with an extension (dot
    /// included) and a mode (less the user's mask). False when the folder does not accept it.
    bool Create(const std::string& folder, std::string_view extension, unsigned mode);
    /// Replaces the content; false when the file system does not take it.
    bool Write(std::string_view text);
    /// Closes and deletes the file.
    void Remove();
    /// Closes the file without deleting it: it has been renamed.
    void Release();

    /// Empty when there is no file.
    const std::string& Path() const { return m_kPath; }
    /// The descriptor, open for reading and writing; below 0 when there is no file.
    int File() const { return m_iFile; }

private:
    std::string m_kPath;
    int m_iFile = -1;
    int m_iLiveName = -1; // see LiveNames
};

/// Writes all bytes at a descriptor's position, or at an offset; false when the file system fails.
bool WriteAll(int file, std::string_view text);
bool WriteAllAt(int file, std::string_view text, uint64_t offset);

} // namespace gw
