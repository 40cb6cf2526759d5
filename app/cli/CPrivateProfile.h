#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A profile that no folder of profiles holds: a private temporary file, gone with the object.
class CPrivateProfile
{
public:
    CPrivateProfile() = default;
    ~CPrivateProfile();
    CPrivateProfile(const CPrivateProfile&) = delete;
    CPrivateProfile& operator=(const CPrivateProfile&) = delete;

    /// Replaces what was written before. False where the folder for temporary files takes none.
    bool Write(std::string_view text);
    /// Empty before the first Write.
    const std::string& Path() const { return m_kPath; }

private:
    std::string m_kPath;
};

} // namespace gw
