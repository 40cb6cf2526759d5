#pragma once

#include "CGaitConvertContent.h"
#include "CPrivateProfile.h"
#include "CProfileTexts.h"
#include "ChooseProfile.h"

#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

struct COptions;
struct CProfileFit;

/// An installed profile.
struct CInstalledProfile
{
    std::string name;
    std::string path;
    bool stock = false;                   ///< installed with the program, not one of the user's own
    std::optional<std::string_view> text; ///< empty if it cannot be read; valid as long as the content
};

/// Whether opening a source selects a stock profile that fits it.
enum class EStockPick : uint8_t
{
    AtOpen,
    Never, ///< a profile will be named
};

/// Never where --profile names one.
EStockPick PickFor(const COptions& options);

/// The conversion as the shell drives it: what a user does by hand in the list of profiles. Nobody sees that
/// list here: which profiles are installed is looked up when it is first asked for, and stands from then on.
class CShellContent : public CGaitConvertContent
{
public:
    /// Both ports must outlive the content.
    CShellContent(CContentWindow& window, CPlatform& platform, EStockPick pick = EStockPick::AtOpen);

    /// The installed profiles, each name once and with the file that it stands for.
    const std::vector<CInstalledProfile>& InstalledProfiles();
    /// The file of a profile that is named by its path, which ends in .prf, or by its display name, or by any
    /// other path. Empty, and says why, for none that can be read.
    std::string ResolveProfile(const std::string& nameOrFile);
    /// Selects such a profile. Says why it cannot.
    bool SelectProfile(const std::string& nameOrFile);
    /// The installed profiles, the best one for the open source first: the stock profile that was chosen when
    /// it was opened, then by ChooseProfile.
    std::vector<ProfileChoice> Choices(EJudged judged = EJudged::All);
    /// Sees to it that a profile is selected: the first of the choices. False, with the reason said, where no
    /// profile fits, when `nearest` tells how far the nearest one does, and where the first one is doubtful.
    bool SelectFittingProfile(const std::string& source, std::optional<CProfileFit>& nearest);
    /// What was selected so; nothing for a profile that was named.
    const std::optional<ProfileChoice>& Chosen() const { return m_kChosen; }
    /// The file of the selected profile, as it may be told: an adapted one lies in a file that is gone when
    /// this is read, and is told as the one that it was made of.
    std::string ToldProfilePath() { return m_kChosen ? m_kChosen->path : ProfilePath(); }
    /// How a profile fits the open source. False when its file cannot be read.
    bool Measure(const std::string& profilePath, CProfileFit& fit) const;

    /// A profile that was named by its file goes before an installed one of the same name.
    std::string FindProfilePath(const std::string& name) override;
    /// Reports a number outside its limits with its place in the profile's file.
    EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers = {}) override;
    void RefreshProfileList() override { KeepStockNames(); }
    void SelectProfileByName(const std::string& name) override;
    void PickStockProfile() override;

private:
    template <class T>
    std::vector<ProfileChoice> HoldAgainstSource(std::span<const T> profiles, EJudged judged) const;
    void ReadInstalled(const std::string& folder, bool stock);
    bool KeepStockPick(const std::string& source);
    bool Take(const std::string& source, const ProfileChoice& choice);
    bool SelectAdapted(const ProfileChoice& choice);

    CContentWindow& m_kWindow;
    EStockPick m_eStockPick;
    std::deque<CProfileTexts> m_kTexts;                         ///< of the folders of installed profiles
    std::optional<std::vector<CInstalledProfile>> m_kInstalled; ///< once asked for
    std::string m_kFileName; ///< display name of the profile in m_kFilePath
    std::string m_kFilePath; ///< of the profile that was named by its file, or empty
    CPrivateProfile m_kAdapted;
    std::optional<ProfileChoice> m_kChosen;
};

} // namespace gw
