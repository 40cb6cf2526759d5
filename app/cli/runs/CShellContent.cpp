#include "CShellContent.h"

#include "CContentWindow.h"
#include "COptions.h"
#include "CProfileFields.h"
#include "CReport.h"
#include "DoubtWords.h"
#include "Paths.h"
#include "ProfileChoice.h"
#include "ProfileFile.h"
#include "ProfileFit.h"
#include "StringTable.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <array>
#include <unordered_set>
#include <utility>

namespace gw {

namespace {

// The stock profiles of old, the one that is asked first.
constexpr const char* kLongKnown[] = {"PoserBVH.prf", "MaxBVH.prf"};

std::vector<std::string> NamesOf(const std::vector<CInstalledProfile>& profiles)
{
    std::vector<std::string> names;
    names.reserve(profiles.size());
    for (const CInstalledProfile& profile : profiles)
        names.push_back(profile.name);
    return names;
}

CReport NotInstalled(const std::string& name, const std::vector<CInstalledProfile>& profiles)
{
    const std::string nearest = NearestName(name, NamesOf(profiles));
    const std::string guess = nearest.empty() ? "" : "; did you mean " + Quoted(nearest) + '?';
    return ShellFailure({}, "not-installed",
                        "profile " + Quoted(name) + " is not installed" + guess +
                            " ('gaitwright profiles' lists them)");
}

// The line of a profile that gives it its frame rate or position, quoted; the last one counts.
CReport NumberReport(const std::string& path, EProfileLine kind)
{
    CReport report;
    report.warning = true;
    report.path = path;
    report.code = "out-of-range";
    std::string text;
    ReadProfileText(path, text);
    CProfileReader reader(text);
    for (CProfileLine line; reader.Next(line);)
    {
        if (line.kind != kind)
            continue;
        const auto& [x, y, z] = line.position;
        report.where = line.line;
        report.name = kind == EProfileLine::FrameRate
                          ? "FrameRate " + std::to_string(line.frameRate)
                          : "Position " + std::to_string(CutToInteger(x)) + ' ' +
                                std::to_string(CutToInteger(y)) + ' ' + std::to_string(CutToInteger(z));
    }
    return report;
}

} // namespace

EStockPick PickFor(const COptions& options)
{
    return options.profile.empty() ? EStockPick::AtOpen : EStockPick::Never;
}

CShellContent::CShellContent(CContentWindow& window, CPlatform& platform, EStockPick pick)
    : CGaitConvertContent(window, platform), m_kWindow(window), m_eStockPick(pick)
{
    OnInitContent(); // its answer tells of the views, which a shell does not have
}

std::string CShellContent::FindProfilePath(const std::string& name)
{
    if (!m_kFilePath.empty() && EqualNoCase(name, m_kFileName))
        return m_kFilePath;
    const std::vector<CInstalledProfile>& installed = InstalledProfiles();
    const auto has = [&](const CInstalledProfile& profile) { return EqualNoCase(profile.name, name); };
    const auto found = std::ranges::find_if(installed, has);
    return found == installed.end() ? std::string() : found->path;
}

const std::vector<CInstalledProfile>& CShellContent::InstalledProfiles()
{
    if (!m_kInstalled)
    {
        m_kInstalled.emplace();
        ReadInstalled(ExeFile({}), true);
        ReadInstalled(ProfileFile({}), false);
    }
    return *m_kInstalled;
}

// Each name once, with the first profile of that name.
void CShellContent::ReadInstalled(const std::string& folder, bool stock)
{
    std::unordered_set<std::string> names;
    for (const CInstalledProfile& profile : *m_kInstalled)
        names.insert(LowerCase(profile.name));
    for (const CProfileTexts::Entry& entry : m_kTexts.emplace_back(folder).Entries())
    {
        if (names.insert(LowerCase(entry.name)).second)
            m_kInstalled->push_back({entry.name, folder + entry.file, stock, entry.text});
    }
}

void CShellContent::SelectProfileByName(const std::string& name)
{
    const std::string path = FindProfilePath(name);
    if (!path.empty())
        UseProfileFile(path);
}

EAnswer CShellContent::ShowMessage(int id, EButtons buttons, std::span<const int> numbers)
{
    if (id != kNumberLimitsMessage)
        return CGaitConvertContent::ShowMessage(id, buttons, numbers);
    const bool isRate = numbers.front() == kLowestFrameRate;
    CReport report =
        NumberReport(ToldProfilePath(), isRate ? EProfileLine::FrameRate : EProfileLine::Position);
    const std::string limits[] = {std::to_string(numbers[0]), std::to_string(numbers[1])};
    report.words = Quoted(report.name) + ": " + FormatText(Message(id), limits);
    m_kWindow.Report(report);
    return EAnswer::OK;
}

void CShellContent::PickStockProfile()
{
    if (m_eStockPick == EStockPick::AtOpen)
        CGaitConvertContent::PickStockProfile();
}

std::string CShellContent::ResolveProfile(const std::string& nameOrFile)
{
    std::string text;
    const bool isFile = HasExtension(nameOrFile, ".prf") && ReadProfileText(nameOrFile, text);
    std::string installed = isFile ? nameOrFile : FindProfilePath(nameOrFile);
    if (!installed.empty())
        return installed;
    if (ReadProfileText(nameOrFile, text))
        return nameOrFile;
    if (HasExtension(nameOrFile, ".prf") || FileExists(nameOrFile))
        m_kWindow.Report(ShellFailure(nameOrFile, "profile", "the profile cannot be read"));
    else
        m_kWindow.Report(NotInstalled(nameOrFile, InstalledProfiles()));
    return {};
}

bool CShellContent::SelectProfile(const std::string& nameOrFile)
{
    m_kFilePath = ResolveProfile(nameOrFile);
    if (m_kFilePath.empty())
        return false;
    m_kFileName = ReadProfileName(m_kFilePath);
    UseProfileFile(m_kFilePath);
    return true;
}

template <class T>
std::vector<ProfileChoice> CShellContent::HoldAgainstSource(std::span<const T> profiles, EJudged judged) const
{
    CNode* const source = SourceRoot();
    CNode* const target = ResultMotion().motionRoot.Get();
    return source && target ? gw::ChooseProfile(profiles, *source, *target, judged)
                            : std::vector<ProfileChoice>();
}

std::vector<ProfileChoice> CShellContent::Choices(EJudged judged)
{
    std::vector<LoadedProfile> profiles;
    for (const CInstalledProfile& profile : InstalledProfiles())
    {
        if (profile.text)
            profiles.push_back({profile.path, *profile.text});
    }
    // Where nothing fits at all, what is told of is a profile that animators know.
    const auto rank =
        [known = std::array{ExeFile(kLongKnown[0]), ExeFile(kLongKnown[1])}](const LoadedProfile& profile) {
            return std::ranges::find(known, profile.path) - known.begin();
        };
    std::ranges::stable_sort(profiles, {}, rank);
    std::vector<ProfileChoice> choices = HoldAgainstSource<LoadedProfile>(profiles, judged);
    const auto pick = std::ranges::find(choices, ProfilePath(), &ProfileChoice::path);
    if (pick != choices.end())
        std::rotate(choices.begin(), pick, pick + 1);
    return choices;
}

bool CShellContent::SelectFittingProfile(const std::string& source, std::optional<CProfileFit>& nearest)
{
    if (!ProfilePath().empty())
        return KeepStockPick(source);
    const std::vector<ProfileChoice> choices = Choices(EJudged::First);
    if (!choices.empty() && choices.front().match.IsWhole())
        return Take(source, choices.front());
    nearest.emplace();
    if (!choices.empty())
        Measure(choices.front().path, *nearest);
    m_kWindow.Report(NoneFitsReport(source, *nearest));
    return false;
}

// A stock profile has always been taken where its rows fit: what speaks against it is a warning.
bool CShellContent::KeepStockPick(const std::string& source)
{
    const std::string path[] = {ProfilePath()};
    for (ProfileChoice& choice : HoldAgainstSource<std::string>(path, EJudged::All))
    {
        std::erase_if(choice.verdict.doubts,
                      [](const ProfileDoubt& doubt) { return !IsOfRoles(doubt.kind); });
        for (const CReport& warning : DoubtWarnings(source, choice))
            m_kWindow.Report(warning);
    }
    return true;
}

bool CShellContent::Take(const std::string& source, const ProfileChoice& choice)
{
    if (choice.verdict.sureness == ESureness::Doubtful)
    {
        m_kWindow.Report(DoubtfulReport(source, choice));
        return false;
    }
    for (const CReport& warning : DoubtWarnings(source, choice))
        m_kWindow.Report(warning);
    m_kChosen = choice;
    if (choice.adapted)
        return SelectAdapted(choice);
    SelectProfileByName(choice.profile.name);
    return true;
}

bool CShellContent::SelectAdapted(const ProfileChoice& choice)
{
    if (m_kAdapted.Write(TextOf(choice.profile)))
        return SelectProfile(m_kAdapted.Path());
    m_kWindow.Report(ShellFailure(choice.path, "adapted", "the profile cannot be written to a temporary file"));
    return false;
}

bool CShellContent::Measure(const std::string& profilePath, CProfileFit& fit) const
{
    return MeasureFit(profilePath, SourceRoot(), ResultMotion().motionRoot.Get(), fit);
}

} // namespace gw
