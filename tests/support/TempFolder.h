#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A new folder of its own that goes with all it holds at its end. Its name and its separator come first in
/// Path.
class CTempFolder
{
public:
    CTempFolder();
    ~CTempFolder();
    CTempFolder(const CTempFolder&) = delete;
    CTempFolder& operator=(const CTempFolder&) = delete;

    /// The path of a name in the folder; of the folder itself, with a separator at its end, for no name.
    std::string Path(std::string_view name = {}) const { return m_kPath + std::string(name); }

private:
    std::string m_kPath;
};

/// Makes a file of these bytes or replaces one. A test that cannot write fails.
void WriteBytes(const std::string& path, std::string_view bytes);
/// All bytes of a file. A test that cannot read fails, and gets none.
std::string ReadBytes(const std::string& path);

/// The folder of files that are too many for this repository, with a separator at its end. Empty where the
/// environment names none: tests that need it return then.
std::string SharedDataFolder();

} // namespace gw
