#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// The target skeleton, in the data folder.
inline constexpr const char* kTargetFile = "base.htr";

/// What the program asks of the system it runs on: settings, folders, language. Paths are UTF-8.
class CPlatform
{
public:
    virtual ~CPlatform() = default;

    /// A value of the program's own settings, section "Settings"; empty when it is absent.
    virtual std::string ReadSetting(const std::string& key) const = 0;
    /// False when the value could not be stored, or when this platform stores nothing.
    virtual bool WriteSetting(const std::string& key, const std::string& value) = 0;
    /// A read-only value of the host product, by key path and value name; empty when it is absent. The key
    /// path is that of a registry: "Software\Maker\Product\Version".
    virtual std::string ReadHostKey(const std::string& keyPath, const std::string& valueName) const = 0;

    /// The user's documents folder.
    virtual std::string DocumentsFolder() const = 0;
    /// The folder of base.htr and the stock profiles with its trailing separator: the executable's or an
    /// installation's, unless another was named.
    virtual std::string DataFolder() const = 0;
    /// Makes a folder; an existing one is no error. A platform that stores nothing makes none.
    virtual bool MakeFolder(const std::string& path) = 0;

    /// The thread's locale by its number; the low ten bits are the primary language. 0 where it has none.
    virtual uint32_t ThreadLocale() const = 0;
};

/// The folder of the user's own profiles with its trailing separator: in the host product's folder of custom
/// data, whose key path is given, else among the user's documents.
std::string CustomProfileFolder(const CPlatform& platform, const std::string& keyPath);

/// The primary language of a locale number.
constexpr uint32_t PrimaryLanguage(uint32_t locale)
{
    return locale & 0x3ff;
}

} // namespace gw
