#pragma once

#include "CPlatform.h"

namespace gw {

/// The platform for Windows: settings in the user's registry below Software\Tessarine\Gaitwright\Settings, or
/// in the machine's for values that the user has not set; the host product's keys in the machine's registry;
/// known folders.
class CRegistryPlatform : public CPlatform
{
public:
    /// `dataFolder`, unless empty, replaces the program's data folder (the executable's or an
    /// installation's).
    explicit CRegistryPlatform(EPlatformWriting writing, std::string dataFolder = {});

    std::string ReadSetting(const std::string& key) const override;
    bool WriteSetting(const std::string& key, const std::string& value) override;
    std::string ReadHostKey(const std::string& keyPath, const std::string& valueName) const override;
    std::string DocumentsFolder() const override;
    std::string DataFolder() const override { return m_kDataFolder; }
    bool MakeFolder(const std::string& path) override;
    uint32_t ThreadLocale() const override;

private:
    bool m_bWriting;
    std::string m_kDataFolder;
};

} // namespace gw
