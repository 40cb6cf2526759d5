#include "CShellContent.h"

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CReport.h"
#include "Paths.h"
#include "ProfileChoice.h"
#include "ProfileFile.h"
#include "ProfileFit.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>

namespace gw {

namespace {

constexpr int kStock = 1; // user data of a list entry

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
                        "no profile " + Quoted(name) + " is installed" + guess +
                            " ('gaitwright profiles' lists them)");
}

} // namespace

CShellContent::CShellContent(CContentWindow& window, CPlatform& platform)
    : CGaitConvertContent(window, platform), m_kWindow(window)
{
    OnInitContent(); // its answer tells of the views, which a shell does not have
}

std::string CShellContent::FindProfilePath(const std::string& name)
{
    if (!m_kFilePath.empty() && EqualNoCase(name, m_kFileName))
        return m_kFilePath;
    return CGaitConvertContent::FindProfilePath(name);
}

std::vector<CInstalledProfile> CShellContent::InstalledProfiles()
{
    std::vector<CInstalledProfile> profiles;
    const CCntComboExControl& list = m_kWindow.ProfileCombo();
    for (int index = 0; const std::string* name = list.GetItemText(index); ++index)
    {
        const auto isNamed = [&](const CInstalledProfile& other) { return EqualNoCase(other.name, *name); };
        const std::string path = FindProfilePath(*name);
        if (!path.empty() && std::ranges::none_of(profiles, isNamed))
            profiles.push_back({*name, path, list.GetItemUserData(index) == kStock});
    }
    return profiles;
}

std::string CShellContent::ResolveProfile(const std::string& nameOrFile)
{
    std::string installed = FindProfilePath(nameOrFile);
    if (!installed.empty())
        return installed;
    std::string text;
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
    const std::string path = ResolveProfile(nameOrFile);
    if (path.empty())
        return false;
    const std::string name = ReadProfileName(path);
    if (FindProfilePath(name) != path)
    {
        m_kFileName = name;
        m_kFilePath = path;
        m_kWindow.ProfileCombo().AddItem(name, 0);
    }
    SelectProfileByName(name);
    return true;
}

bool CShellContent::SelectFittingProfile(CProfileFit& best)
{
    if (!ProfilePath().empty())
        return true; // a stock profile, chosen when the source was opened
    best = {};
    for (const CInstalledProfile& profile : InstalledProfiles())
    {
        CProfileFit fit;
        if (Measure(profile.path, fit) && IsBetterFit(fit, best))
            best = fit;
    }
    if (!best.IsWhole() || best.rowCount == 0)
        return false;
    SelectProfileByName(best.name);
    return true;
}

bool CShellContent::Measure(const std::string& profilePath, CProfileFit& fit) const
{
    return MeasureFit(profilePath, SourceRoot(), ResultMotion().motionRoot.Get(), fit);
}

} // namespace gw
