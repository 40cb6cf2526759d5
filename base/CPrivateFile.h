#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A file of a private name, which nobody but its user may read, for what stands between two steps. It goes
/// with the object.
class CPrivateFile
{
public:
    /// Creates an empty file in the folder of a path, with an extension, dot included.
    CPrivateFile(const std::string& besidePath, std::string_view extension);
    ~CPrivateFile();
    CPrivateFile(const CPrivateFile&) = delete;
    CPrivateFile& operator=(const CPrivateFile&) = delete;

    /// Empty where the folder takes no file.
    const std::string& Path() const { return m_kPath; }

private:
    std::string m_kPath;
};

/// Creates a file that nobody else has, in a folder with a separator at its end, for reading and writing.
/// Answers its descriptor, or below 0, with an empty path, where the folder takes none.
int CreatePrivateFile(const std::string& folder, std::string_view extension, unsigned mode,
                      std::string& path);

} // namespace gw
