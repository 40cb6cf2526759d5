#pragma once

#include "CFileConversion.h"
#include "CMendedSource.h"
#include "CProfileTexts.h"
#include "CSourceFile.h"
#include "ChooseProfile.h"
#include "ProfileFit.h"

#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CDraftShelf;
class CShellNotices;
struct ShellOptions;

/// An installed profile.
struct InstalledProfile
{
    std::string name;
    std::string path;
    bool stock = false; ///< installed with the program, not the user's own
    std::optional<std::string_view>
        text; ///< no value if it cannot be read; valid as long as the conversion exists
};

/// The conversion of the shell program, including the choice of a profile. The installed profiles are listed
/// when first needed, and the list is kept.
class CShellConversion : public CFileConversion
{
public:
    /// Options and notices must outlive the conversion.
    CShellConversion(const ShellOptions& options, const ConversionChoices& choices, CShellNotices& notices);

    /// With the option --draft: where drafted profiles are found and kept. Must outlive the conversion.
    void UseDrafts(CDraftShelf& drafts) { m_pkDrafts = &drafts; }

    /// Reads a source, repaired if the options say so. Returns false, after reporting the reason, if that
    /// fails.
    bool ReadSource(const std::string& path);
    /// Opens a source and loads the target. If no profile was named, selects a stock profile that fits.
    /// Returns false, after reporting the reason, if anything failed.
    bool Open(const std::string& path);
    /// Returns the installed profiles with their files, each name once.
    const std::vector<InstalledProfile>& InstalledProfiles();
    /// Returns the file of a profile, given by a path ending in .prf, by its display name, or by any other
    /// path. Returns an empty path, after printing the reason, if none can be read.
    std::string ResolveProfile(const std::string& nameOrFile);
    /// Selects the profile named in the options, or the best one. Returns false, after reporting the reason,
    /// if the profile cannot be read, if none fits the source, or if the best one is doubtful.
    bool SelectProfile();
    /// Returns the installed profiles, best first, for the open source: the stock profile selected at open,
    /// then the others in ChooseProfile's order.
    std::vector<ProfileChoice> Choices(EJudged judged = EJudged::All);
    /// Returns the chosen profile; no value for a named profile or an original stock profile.
    const std::optional<ProfileChoice>& Chosen() const { return chosen_; }
    bool IsAdapted() const { return chosen_ && chosen_->adapted; }
    /// Returns whether the profile was drafted for the source's skeleton.
    bool IsDrafted() const { return m_bDrafted; }
    /// Returns the copy that was read in place of the source, and what was repaired in it.
    const CMendedSource& Mended() const { return m_kMended; }
    /// Returns the file that was read: the source, or a copy that exists as long as the conversion.
    const std::string& ReadPath() const { return m_kMended.IsMended() ? m_kMended.Path() : m_kSource.Path(); }
    /// Saves the result in the format of the extension, changed as the options say. `taken` as for
    /// WriteResult.
    bool WriteEdited(const std::string& path, bool* taken = nullptr);
    /// Returns the changes that the options ask for.
    MotionEdits Edits() const;
    /// Returns how well the closest profile fits if none fits fully.
    const std::optional<CProfileFit>& Nearest() const { return nearest_; }
    /// Measures how a profile fits the open source. Returns false if its file cannot be read.
    bool Measure(const std::string& profilePath, CProfileFit& fit) const;

private:
    void ReadInstalled(const std::string& folder, bool stock);
    std::string FindProfile(const std::string& name);
    void PickStockProfile();
    bool SelectFitting();
    bool IsAsInFile(const std::string& profilePath);
    bool SelectStockPick();
    bool UseDraft();
    void NotifyWithDraft(Notice notice) const;
    bool Take(const ProfileChoice& choice);

    const ShellOptions& options_;
    const CShellNotices& notices_;
    CProfileTexts::EPack pack_ = CProfileTexts::EPack::Used;
    std::deque<CProfileTexts> m_kTexts;                      ///< of the folders of installed profiles
    std::optional<std::vector<InstalledProfile>> installed_; ///< set when first needed
    std::optional<ProfileChoice> chosen_;
    std::optional<CProfileFit> nearest_;
    CSourceFile m_kSource;
    CMendedSource m_kMended;
    CDraftShelf* m_pkDrafts = nullptr;
    bool m_bDrafted = false;
    std::string m_kWhyNoDraft;   ///< empty if no draft was tried
    bool m_bDraftUnsure = false; ///< there is one that a person could check
};

} // namespace gw
