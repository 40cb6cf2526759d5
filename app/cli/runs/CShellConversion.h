#pragma once

#include "CFileConversion.h"
#include "CProfileTexts.h"
#include "ChooseProfile.h"
#include "ProfileFit.h"

#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CShellReports;
struct ShellOptions;

/// An installed profile.
struct InstalledProfile
{
    std::string name;
    std::string path;
    bool stock = false;                   ///< installed with the program, not one of the user's own
    std::optional<std::string_view> text; ///< empty if it cannot be read; valid as long as the conversion
};

/// The conversion as the shell drives it: with a choice of its profile. Which profiles are installed is
/// looked up when it is first asked for, and stands from then on.
class CShellConversion : public CFileConversion
{
public:
    /// Options and reports must outlive the conversion.
    CShellConversion(const ShellOptions& options, const ConversionChoices& choices, CShellReports& reports);

    /// Opens a source and loads the target. Where no profile was named takes a stock profile that fits the
    /// source. False, with the reason said, where anything failed.
    bool Open(const std::string& path);
    /// The installed profiles, each name once and with the file that it stands for.
    const std::vector<InstalledProfile>& InstalledProfiles();
    /// The file of a profile that is named by its path, which ends in .prf, or by its display name, or by any
    /// other path. Empty, and says why, for none that can be read.
    std::string ResolveProfile(const std::string& nameOrFile);
    /// Selects the profile that the options name, or the first of the choices. False, with the reason said,
    /// where it cannot be read, where no profile fits the source, and where the first one is doubtful.
    bool SelectProfile();
    /// The installed profiles, the best one for the open source first: the stock profile that was chosen when
    /// it was opened, then by ChooseProfile.
    std::vector<ProfileChoice> Choices(EJudged judged = EJudged::All);
    /// What was chosen; nothing for a profile that was named or is the stock one of old.
    const std::optional<ProfileChoice>& Chosen() const { return chosen_; }
    bool IsAdapted() const { return chosen_ && chosen_->adapted; }
    /// How far the nearest profile fits, where none did.
    const std::optional<CProfileFit>& Nearest() const { return nearest_; }
    /// How a profile fits the open source. False when its file cannot be read.
    bool Measure(const std::string& profilePath, CProfileFit& fit) const;

private:
    void ReadInstalled(const std::string& folder, bool stock);
    std::string FindProfile(const std::string& name);
    void PickStockProfile();
    bool SelectFitting();
    void WarnOfStockPick() const;
    bool Take(const ProfileChoice& choice);

    const ShellOptions& options_;
    const CShellReports& reports_;
    std::deque<CProfileTexts> m_kTexts;                      ///< of the folders of installed profiles
    std::optional<std::vector<InstalledProfile>> installed_; ///< once asked for
    std::optional<ProfileChoice> chosen_;
    std::optional<CProfileFit> nearest_;
};

} // namespace gw
