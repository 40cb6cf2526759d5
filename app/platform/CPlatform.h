#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// The target skeleton, in the data folder.
inline constexpr const char* kTargetFile = "base.htr";

/// Whether a platform may write anything.
enum class EPlatformWriting
{
    No,  ///< settings are not stored and folders not created
    Yes, ///< as in a desktop program
};

/// What the program needs from the operating system: settings, folders, language. Paths are UTF-8.
class CPlatform
{
public:
    virtual ~CPlatform() = default;

    /// Returns a value of the program's own settings, section "Settings"; empty if it is missing.
    virtual std::string ReadSetting(const std::string& key) const = 0;
    /// Returns false if the value could not be stored, or if this platform stores nothing.
    virtual bool WriteSetting(const std::string& key, const std::string& value) = 0;
    /// Returns a read-only value of the host product, by key path and value name; empty if it is missing. Key
    /// paths have the form of a registry: "Software\Maker\Product\Version".
    virtual std::string ReadHostKey(const std::string& keyPath, const std::string& valueName) const = 0;

    /// Returns the user's documents folder.
    virtual std::string DocumentsFolder() const = 0;
    /// Returns the folder of base.htr and the stock profiles with a trailing separator: the executable's or
    /// an installation's, unless another one was given.
    virtual std::string DataFolder() const = 0;
    /// Creates a folder; succeeds if it exists. A platform that stores nothing creates none.
    virtual bool MakeFolder(const std::string& path) = 0;

    /// Returns the thread's locale number, whose low ten bits are the primary language; 0 without one.
    virtual uint32_t ThreadLocale() const = 0;
};

/// Returns the folder of the user's own profiles with a trailing separator: in the host product's folder of
/// custom data, whose key path is given, or in the user's documents if the product is not installed.
std::string CustomProfileFolder(const CPlatform& platform, const std::string& keyPath);

/// Returns the folder of the program's data with a trailing separator: next to the executable, as in a build.
/// An installation keeps files that are the same on all machines in a separate folder.
std::string InstalledDataFolder();

/// Returns the primary language of a locale number.
constexpr uint32_t PrimaryLanguage(uint32_t locale)
{
    return locale & 0x3ff;
}

} // namespace gw
