#pragma once

#include "CFileConversion.h"
#include "CProfileTexts.h"
#include "ChooseProfile.h"
#include "ProfileFit.h"

#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

/// An installed profile.
struct InstalledProfile
{
    std::string name;
    std::string path;
    bool stock = false; ///< installed with the program, not the user's own
    std::optional<std::string_view>
        text; ///< no value if it cannot be read; valid as long as the conversion exists
};

/// A conversion that chooses its profile, between LoadTarget and Convert. The installed profiles are listed
/// when first needed, and the list is kept.
class CChoosingConversion : public CFileConversion
{
public:
    /// `profile` is a name or a path, or empty to choose one.
    CChoosingConversion(const std::string& dataFolder, std::string profile, const ConversionChoices& choices,
                        NoticeListener listener)
        : CFileConversion(dataFolder, choices, std::move(listener)), wanted_(std::move(profile))
    {
    }
    virtual ~CChoosingConversion() = default;

    /// Returns the installed profiles with their files, each name once.
    const std::vector<InstalledProfile>& InstalledProfiles();
    /// Returns the file of a profile, given by a path ending in .prf, by its display name, or by any other
    /// path. Returns an empty path, after sending a notice of the reason, if none can be read.
    std::string ResolveProfile(const std::string& nameOrFile);
    /// Uses the first stock profile that fits the source. If neither fits, the profile is still to be chosen.
    void PickStockProfile();
    /// Selects the wanted profile, or the best one after PickStockProfile. Returns false, after sending a
    /// notice of the reason, if the profile cannot be read, if none fits the source, or if the best one is
    /// doubtful.
    bool SelectProfile();
    /// Returns the installed profiles, best first, for the open source: the stock profile selected at open,
    /// then the others in ChooseProfile's order.
    std::vector<ProfileChoice> Choices(EJudged judged = EJudged::All);
    /// Returns the chosen profile; no value for a named profile or an original stock profile.
    const std::optional<ProfileChoice>& Chosen() const { return chosen_; }
    bool IsAdapted() const { return chosen_ && chosen_->adapted; }
    /// Returns how well the closest profile fits if none fits fully.
    const std::optional<CProfileFit>& Nearest() const { return nearest_; }
    /// Measures how a profile fits the open source. Returns false if its file cannot be read.
    bool Measure(const std::string& profilePath, CProfileFit& fit) const;

protected:
    /// Uses a draft for the source's skeleton, if drafts are allowed and there is a good one. Returns false
    /// otherwise.
    virtual bool UseDraft() { return false; }
    /// Sends the notice that no profile is used, and no draft.
    virtual void NotifyOfNone(const Notice& notice) const { Notify(notice); }

private:
    void ReadInstalled(const std::string& folder, bool stock);
    std::string FindProfile(const std::string& name);
    bool SelectFitting();
    bool IsAsInFile(const std::string& profilePath);
    bool SelectStockPick();
    bool Take(const ProfileChoice& choice);

    std::string wanted_;
    CProfileTexts::EPack pack_ = CProfileTexts::EPack::Used;
    std::deque<CProfileTexts> m_kTexts;                      ///< of the folders of installed profiles
    std::optional<std::vector<InstalledProfile>> installed_; ///< set when first needed
    std::optional<ProfileChoice> chosen_;
    std::optional<CProfileFit> nearest_;
};

} // namespace gw
