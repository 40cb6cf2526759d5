#pragma once

#include "CPlatform.h"

#include <string_view>
#include <vector>

namespace gw {

/// Whether a platform leaves anything behind.
enum class EPlatformWriting
{
    No,  ///< settings are not stored and folders not made
    Yes, ///< as a desktop program does
};

/// The platform of a system with the freedesktop folders, in plain files and without a toolkit: settings in
/// Tessarine/Gaitwright.conf of the configuration folders, the host product's keys in Tessarine/PRODUCT.conf
/// of the system's ones. The environment is read once, when it is made.
class CFilePlatform : public CPlatform
{
public:
    /// The data folder replaces the program's own unless it is empty: the executable's, or an installation's.
    explicit CFilePlatform(EPlatformWriting writing, std::string dataFolder = {});

    std::string ReadSetting(const std::string& key) const override;
    bool WriteSetting(const std::string& key, const std::string& value) override;
    std::string ReadHostKey(const std::string& keyPath, const std::string& valueName) const override;
    std::string DocumentsFolder() const override;
    std::string DataFolder() const override { return m_kDataFolder; }
    bool MakeFolder(const std::string& path) override;
    uint32_t ThreadLocale() const override;

private:
    std::string FindValue(const std::vector<std::string>& folders, std::string_view file,
                          std::string_view section, std::string_view key) const;

    bool m_bWriting;
    std::string m_kDataFolder;
    std::string m_kHome;
    std::string m_kUserFolder;                 ///< the user's configuration
    std::vector<std::string> m_kSystemFolders; ///< the system's, the first one counts most
};

} // namespace gw
