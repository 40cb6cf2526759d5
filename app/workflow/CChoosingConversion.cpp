// Chooses the bone map of a conversion. A named one is used as it is. Without a name, a stock map is used if
// all its rows match the source, for compatibility. Otherwise the best installed map is used, unless the
// joint positions contradict it: then the user must name it. If drafts are allowed, a map is drafted for the
// skeleton instead of giving up.

#include "CChoosingConversion.h"

#include "DoubtWords.h"
#include "FindBone.h"
#include "FindingWords.h"
#include "FitWords.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "ProfileNames.h"
#include "StringTable.h"
#include "SystemError.h"
#include "Text.h"

#include <algorithm>
#include <array>
#include <unordered_set>

namespace gw {

namespace {

// The original stock profiles, in the order they are tried.
constexpr const char* kLongKnown[] = {"PoserBVH.prf", "MaxBVH.prf"};

std::vector<std::string> NamesOf(const std::vector<InstalledProfile>& profiles)
{
    std::vector<std::string> names;
    names.reserve(profiles.size());
    for (const InstalledProfile& profile : profiles)
        names.push_back(profile.name);
    return names;
}

Notice NotInstalled(const std::string& name, const std::vector<InstalledProfile>& profiles)
{
    const std::string nearest = NearestName(name, NamesOf(profiles));
    const std::string guess = nearest.empty() ? "" : "; did you mean " + Quoted(nearest) + '?';
    return MakeNotice({}, "not-installed",
                      "profile " + Quoted(name) + " is not installed" + guess +
                          " ('gaitwright profiles' lists them)");
}

} // namespace

// Selects the first stock profile that fits.
void CChoosingConversion::PickStockProfile()
{
    InstalledProfiles();
    for (const char* file : kLongKnown)
    {
        const std::span<const CProfileTexts::Entry> stock = m_kTexts.front().Entries();
        const auto found = std::ranges::find(stock, file, &CProfileTexts::Entry::file);
        if (found == stock.end() || !found->text || !RowsThatMayFit(*found->text, SourceNames()))
            continue;
        const RowMatch match =
            ApplyRows(RowsOfText(*found->text).rows, SourceNames(), TargetNames(), nullptr);
        const bool fits = match.foundCount == match.rowCount && match.mappedCount > 0;
        if (const std::string path = fits ? FindProfile(found->name) : ""; !path.empty())
        {
            UseProfile(path);
            return;
        }
    }
}

std::string CChoosingConversion::FindProfile(const std::string& name)
{
    const auto has = [&](const InstalledProfile& profile) { return EqualNoCase(profile.name, name); };
    const auto found = std::ranges::find_if(InstalledProfiles(), has);
    return found == installed_->end() ? std::string() : found->path;
}

const std::vector<InstalledProfile>& CChoosingConversion::InstalledProfiles()
{
    if (!installed_)
    {
        installed_.emplace();
        ReadInstalled(DataFile({}), true);
        ReadInstalled(CustomProfileFolder(Platform(), Message(kCustomFolderKeyMessage)), false);
    }
    return *installed_;
}

// Keeps the first profile of each name.
void CChoosingConversion::ReadInstalled(const std::string& folder, bool stock)
{
    const std::span<const CProfileTexts::Entry> entries = m_kTexts.emplace_back(folder, pack_).Entries();
    if (entries.empty())
        return;
    std::unordered_set<std::string> names;
    for (const InstalledProfile& profile : *installed_)
        names.insert(LowerCase(profile.name));
    installed_->reserve(installed_->size() + entries.size());
    for (const CProfileTexts::Entry& entry : entries)
    {
        if (names.insert(LowerCase(entry.name)).second)
            installed_->push_back({entry.name, folder + entry.file, stock, entry.text});
    }
}

std::string CChoosingConversion::ResolveProfile(const std::string& nameOrFile)
{
    std::string text;
    const bool isFile = HasExtension(nameOrFile, ".prf") && ReadProfileText(nameOrFile, text);
    std::string installed = isFile ? nameOrFile : FindProfile(nameOrFile);
    if (!installed.empty())
        return installed;
    if (ReadProfileText(nameOrFile, text))
        return nameOrFile;
    if (HasExtension(nameOrFile, ".prf") || FileExists(nameOrFile))
        Notify(MakeNotice(nameOrFile, {.reason = EFailure::BadProfile, .systemError = TakeSystemError()}));
    else
        Notify(NotInstalled(nameOrFile, InstalledProfiles()));
    return {};
}

bool CChoosingConversion::SelectProfile()
{
    if (!wanted_.empty())
    {
        const std::string path = ResolveProfile(wanted_);
        return !path.empty() && UseProfile(path);
    }
    if (ProfilePath().empty())
        return SelectFitting();
    return SelectStockPick();
}

std::vector<ProfileChoice> CChoosingConversion::Choices(EJudged judged)
{
    std::vector<LoadedProfile> profiles;
    for (const InstalledProfile& profile : InstalledProfiles())
    {
        if (profile.text)
            profiles.push_back({profile.path, *profile.text});
    }
    // If nothing fits at all, prefer to report a profile that animators know.
    const auto rank =
        [known = std::array{DataFile(kLongKnown[0]), DataFile(kLongKnown[1])}](const LoadedProfile& profile) {
            return std::ranges::find(known, profile.path) - known.begin();
        };
    std::ranges::stable_sort(profiles, {}, rank);
    std::vector<ProfileChoice> choices = ChooseProfile(profiles, SourceNames(), TargetNames(), judged);
    const auto pick = std::ranges::find(choices, ProfilePath(), &ProfileChoice::path);
    if (pick != choices.end())
        std::rotate(choices.begin(), pick, pick + 1);
    return choices;
}

// Returns false if a profile was chosen by a packed text that its file no longer has.
bool CChoosingConversion::IsAsInFile(const std::string& profilePath)
{
    const auto profile = std::ranges::find(InstalledProfiles(), profilePath, &InstalledProfile::path);
    std::string text;
    return ReadProfileText(profilePath, text) && text == profile->text;
}

bool CChoosingConversion::SelectFitting()
{
    std::vector<ProfileChoice> choices = Choices(EJudged::First);
    if (!choices.empty() && !IsAsInFile(choices.front().path))
    {
        pack_ = CProfileTexts::EPack::Ignored;
        installed_.reset();
        m_kTexts.clear();
        choices = Choices(EJudged::First);
    }
    if (!choices.empty() && choices.front().match.IsWhole())
        return Take(choices.front());
    if (UseDraft())
        return true;
    nearest_.emplace();
    if (!choices.empty())
        Measure(choices.front().path, *nearest_);
    NotifyOfNone(NoneFitsNotice(SourcePath(), *nearest_));
    return false;
}

// For compatibility, a stock profile is used whenever its rows fit, so doubts about it are only warnings. A
// draft is better than a doubtful one.
bool CChoosingConversion::SelectStockPick()
{
    const std::string path[] = {ProfilePath()};
    for (ProfileChoice& choice : ChooseProfile(path, *SourceRoot(), *Result().motionRoot))
    {
        if (choice.verdict.sureness == ESureness::Doubtful && UseDraft())
            return true;
        std::erase_if(choice.verdict.doubts,
                      [](const ProfileDoubt& doubt) { return !IsOfRoles(doubt.kind); });
        for (const Notice& warning : DoubtWarnings(SourcePath(), choice))
            Notify(warning);
    }
    return true;
}

bool CChoosingConversion::Take(const ProfileChoice& choice)
{
    if (choice.verdict.sureness == ESureness::Doubtful)
    {
        if (UseDraft())
            return true;
        NotifyOfNone(DoubtfulNotice(SourcePath(), choice));
        return false;
    }
    for (const Notice& warning : DoubtWarnings(SourcePath(), choice))
        Notify(warning);
    chosen_ = choice;
    UseProfile(choice.path, choice.profile);
    return true;
}

bool CChoosingConversion::Measure(const std::string& profilePath, CProfileFit& fit) const
{
    return MeasureFit(profilePath, SourceRoot(), Result().motionRoot.Get(), fit);
}

} // namespace gw
