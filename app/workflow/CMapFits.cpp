#include "CMapFits.h"

#include "CProfileTexts.h"
#include "DoubtWords.h"
#include "FindBone.h"
#include "Text.h"

#include <algorithm>
#include <deque>
#include <unordered_set>

namespace gw {

namespace {

bool IsNear(const ProfileChoice& choice)
{
    return 2 * choice.match.foundCount >= choice.match.rowCount && choice.match.rowCount > 0;
}

std::string Share(const RowMatch& match)
{
    return std::to_string(match.foundCount) + " of " + std::to_string(match.rowCount);
}

} // namespace

void CMapFits::Measure(std::span<const std::string> folders, CNode& source, CNode& target)
{
    std::deque<CProfileTexts> texts;
    std::vector<LoadedProfile> profiles;
    std::unordered_set<std::string> names;
    for (const std::string& folder : folders)
    {
        for (const CProfileTexts::Entry& entry : texts.emplace_back(folder).Entries())
        {
            if (entry.text && names.insert(LowerCase(entry.name)).second)
                profiles.push_back({folder + entry.file, *entry.text});
        }
    }
    choices_ =
        ChooseProfile(std::span<const LoadedProfile>(profiles), CBoneNames(&source), CBoneNames(&target));
}

const ProfileChoice* CMapFits::Best() const
{
    return !choices_.empty() && choices_.front().match.IsWhole() ? &choices_.front() : nullptr;
}

const ProfileChoice* CMapFits::Find(std::string_view name) const
{
    const auto is = [&](const ProfileChoice& choice) {
        return !choice.adapted && EqualNoCase(choice.profile.name, name);
    };
    const auto found = std::ranges::find_if(choices_, is);
    return found == choices_.end() ? nullptr : &*found;
}

size_t CMapFits::RankOf(std::string_view name) const
{
    const ProfileChoice* const choice = Find(name);
    return choice && IsNear(*choice) ? static_cast<size_t>(choice - choices_.data()) : choices_.size();
}

std::string CMapFits::WordsOf(std::string_view name) const
{
    const ProfileChoice* const choice = Find(name);
    if (!choice || !IsNear(*choice))
        return {};
    if (!choice->match.IsWhole())
        return Share(choice->match);
    return std::string(choice == Best() ? "best fit, " : "fits, ") + SurenessName(choice->verdict.sureness);
}

std::string CMapFits::TipOf(const std::string& name) const
{
    const ProfileChoice* const choice = Find(name);
    if (!choice)
        return name;
    if (!choice->match.IsWhole())
        return name + "\nDoes not fit: " + Share(choice->match) + " rows match";
    std::string tip = name + "\nAll rows match: " + SurenessName(choice->verdict.sureness);
    for (const std::string& doubt : DoubtWords(choice->verdict))
        tip += '\n' + doubt;
    return tip;
}

} // namespace gw
