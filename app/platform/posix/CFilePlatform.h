#pragma once

#include "CPlatform.h"

#include <string_view>
#include <vector>

namespace gw {

/// The platform for systems with freedesktop folders, using plain files and no toolkit: settings in
/// Tessarine/Gaitwright.conf of the configuration folders, the host product's keys in Tessarine/PRODUCT.conf
/// of the system's folders. The environment is read once, by the constructor.
class CFilePlatform : public CPlatform
{
public:
    /// `dataFolder`, unless empty, replaces the program's data folder (the executable's or an
    /// installation's).
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
    std::string m_kUserFolder;                 ///< user's configuration folder
    std::vector<std::string> m_kSystemFolders; ///< system's configuration folders, most important first
};

} // namespace gw
