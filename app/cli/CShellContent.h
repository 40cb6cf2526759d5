#pragma once

#include "CGaitConvertContent.h"

#include <string>
#include <vector>

namespace gw {

struct CProfileFit;

/// An installed profile.
struct CInstalledProfile
{
    std::string name;
    std::string path;
    bool stock = false; ///< beside the program, and not one of the user's own
};

/// The conversion as the shell drives it: what a user does by hand in the list of profiles.
class CShellContent : public CGaitConvertContent
{
public:
    /// Both ports must outlive the content.
    CShellContent(CContentWindow& window, CPlatform& platform);

    /// The profiles of the list, each name once and with the file that it stands for.
    std::vector<CInstalledProfile> InstalledProfiles();
    /// The file of a profile that is named by its display name or by its path. Empty, and says why, for none
    /// that can be read.
    std::string ResolveProfile(const std::string& nameOrFile);
    /// Selects such a profile. Says why it cannot.
    bool SelectProfile(const std::string& nameOrFile);
    /// Sees to it that a profile is selected: the stock profile that fits the open source, else the installed
    /// one of which all rows fit, with the most rows. False where none does; `best` is the nearest then,
    /// without rows where none is installed.
    bool SelectFittingProfile(CProfileFit& best);
    /// How a profile fits the open source. False when its file cannot be read.
    bool Measure(const std::string& profilePath, CProfileFit& fit) const;

    /// A profile that was named by its file goes before an installed one of the same name.
    std::string FindProfilePath(const std::string& name) override;

private:
    CContentWindow& m_kWindow;
    std::string m_kFileName; ///< display name of the profile in m_kFilePath
    std::string m_kFilePath; ///< of the profile that was named by its file, or empty
};

} // namespace gw
