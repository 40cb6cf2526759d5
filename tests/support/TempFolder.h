#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A new temporary folder, deleted with its contents by the destructor. Path returns paths that start with
/// its name and a separator.
class CTempFolder
{
public:
    CTempFolder();
    ~CTempFolder();
    CTempFolder(const CTempFolder&) = delete;
    CTempFolder& operator=(const CTempFolder&) = delete;

    /// Returns the path of a name in the folder; without a name, the folder itself with a trailing separator.
    std::string Path(std::string_view name = {}) const { return m_kPath + std::string(name); }

private:
    std::string m_kPath;
};

/// Creates or replaces a file. If it cannot be written, the test fails.
void WriteBytes(const std::string& path, std::string_view bytes);
/// Returns the bytes of a file. If it cannot be read, the test fails and gets no bytes.
std::string ReadBytes(const std::string& path);

/// Same for a text file of this program, with "\n" for the platform's line ends.
std::string ReadText(const std::string& path);

/// Creates a symbolic link; false where the system, or the user, cannot have any.
bool MakeLink(const std::string& target, const std::string& path);

/// Returns the folder of files that are too large for this repository, with a trailing separator. Empty if
/// the environment does not name one; tests that need it then return.
std::string SharedDataFolder();

} // namespace gw
