// Chooses a bone map for a source. Every map is matched against the source's bone names. If only the first
// choice is needed, maps whose first rows name a missing bone are skipped, which is nearly all of them, and
// so are those with fewer rows than one that fits. If none fits as it is, the maps are tried again with the
// source's name prefix in place of their own. Maps that fit are then judged by the geometry of the joints
// (JudgeProfile), which costs far more than matching, and sorted.

#include "ChooseProfile.h"

#include "CRetargeter.h"
#include "FindBone.h"
#include "ProfileFile.h"
#include "SharedPrefix.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>
#include <array>
#include <deque>
#include <functional>
#include <iterator>
#include <map>
#include <optional>
#include <set>
#include <tuple>

namespace gw {

namespace {

// Both skeletons, analyzed once for all profiles.
class CSkeletons
{
public:
    CSkeletons(const CBoneNames& sources, const CBoneNames& targets)
        : sources_(sources), targets_(targets), m_kTargetNodes(*targets.Root())
    {
    }

    void Match(ProfileChoice& choice) const;
    void Judge(ProfileChoice& choice);
    const CBoneNames& Sources() const { return sources_; }
    const std::vector<std::string>& SourceNames() const { return sources_.Names(); }

private:
    // Analysis that needs several poses is delayed until a profile fits.
    SourceBody& Body()
    {
        if (!body_)
            body_.emplace(*sources_.Root());
        return *body_;
    }

    const CBoneNames& sources_;
    const CBoneNames& targets_;
    CNodeNames m_kTargetNodes;
    std::optional<SourceBody> body_;
};

void CSkeletons::Match(ProfileChoice& choice) const
{
    choice.match = ApplyRows(choice.profile.rows, sources_, targets_, nullptr);
}

void CSkeletons::Judge(ProfileChoice& choice)
{
    CRetargeter table;
    ApplyRows(choice.profile.rows, sources_, targets_, &table);
    choice.verdict = JudgeProfile(table, m_kTargetNodes, Body());
}

// Larger is better. A profile that does not fit completely is ranked by its share of matching rows.
auto Rank(const ProfileChoice& choice)
{
    const RowMatch& match = choice.match;
    const ProfileVerdict& verdict = choice.verdict;
    const bool whole = match.IsWhole();
    const double share = whole ? 1.0 : static_cast<double>(match.mappedCount) / std::max(match.rowCount, 1);
    return std::tuple(whole, share, whole ? match.rowCount : 0, verdict.sureness != ESureness::Doubtful,
                      -static_cast<double>(verdict.leftOut), -verdict.turn);
}

ProfileChoice Adapted(const ProfileChoice& choice, const std::string& oldPrefix, const std::string& newPrefix)
{
    ProfileChoice adapted = choice;
    adapted.adapted = true;
    adapted.profile.rows = WithPrefix(choice.profile.rows, oldPrefix, newPrefix);
    adapted.profile.name += newPrefix.empty() ? ", no prefix" : ", prefix " + newPrefix;
    return adapted;
}

// Variants of a profile with a prefix before its names, and with a prefix in place of its own.
std::vector<ProfileChoice> AdaptedOnes(const ProfileChoice& choice, const std::vector<std::string>& prefixes,
                                       CSkeletons& skeletons)
{
    std::set<std::string> oldPrefixes{"", SourcePrefix(choice.profile.rows)};
    std::vector<ProfileChoice> whole;
    for (const std::string& oldPrefix : oldPrefixes)
    {
        for (const std::string& newPrefix : prefixes)
        {
            if (EqualNoCase(oldPrefix, newPrefix))
                continue;
            whole.push_back(Adapted(choice, oldPrefix, newPrefix));
            skeletons.Match(whole.back());
            if (!whole.back().match.IsWhole())
                whole.pop_back();
        }
    }
    return whole;
}

// Profiles whose own prefix resembles the source's come first, because their names are the most significant.
std::vector<ProfileChoice> AdaptToPrefix(const std::vector<ProfileChoice>& choices, CSkeletons& skeletons)
{
    std::vector<std::string> prefixes = SharedPrefixes(skeletons.SourceNames());
    prefixes.emplace_back();
    std::multimap<size_t, ProfileChoice, std::greater<>> byKinship;
    for (const ProfileChoice& choice : choices)
    {
        const std::string ownPrefix = SourcePrefix(choice.profile.rows);
        const std::array<std::string_view, 2> both{ownPrefix, prefixes.front()};
        for (ProfileChoice& adapted : AdaptedOnes(choice, prefixes, skeletons))
            byKinship.emplace(CommonStart(both).size(), std::move(adapted));
    }
    std::vector<ProfileChoice> whole;
    for (auto& [length, adapted] : byKinship)
        whole.push_back(std::move(adapted));
    return whole;
}

// A verdict costs more than matching all rows. If only the first choice matters, profiles with fewer rows
// than another need none.
void JudgeWhole(std::vector<ProfileChoice>& choices, CSkeletons& skeletons, EJudged judged)
{
    int mostRows = 0;
    for (const ProfileChoice& choice : choices)
        mostRows = std::max(mostRows, choice.match.IsWhole() ? choice.match.rowCount : 0);
    for (ProfileChoice& choice : choices)
    {
        if (choice.match.IsWhole() && (judged == EJudged::All || choice.match.rowCount == mostRows))
            skeletons.Judge(choice);
    }
}

bool AnyFits(const std::vector<ProfileChoice>& choices)
{
    return std::ranges::any_of(choices, [](const ProfileChoice& choice) { return choice.match.IsWhole(); });
}

ProfileChoice Read(const LoadedProfile& profile, const CSkeletons& skeletons)
{
    ProfileChoice choice{profile.path, RowsOfText(profile.text), false, {}, {}};
    skeletons.Match(choice);
    return choice;
}

std::vector<ProfileChoice> ReadAll(std::span<const LoadedProfile> profiles, const CSkeletons& skeletons)
{
    std::vector<ProfileChoice> choices;
    choices.reserve(profiles.size()); // growing would copy all rows
    for (const LoadedProfile& profile : profiles)
        choices.push_back(Read(profile, skeletons));
    return choices;
}

// Reads only the profiles that can fit completely and be the first choice. Profiles with equally many rows
// keep their order.
std::vector<ProfileChoice> ReadPromising(std::span<const LoadedProfile> profiles, const CSkeletons& skeletons)
{
    std::multimap<size_t, const LoadedProfile*, std::greater<>> byRows;
    for (const LoadedProfile& profile : profiles)
    {
        if (const std::optional<size_t> rows = RowsThatMayFit(profile.text, skeletons.Sources()))
            byRows.emplace(*rows, &profile);
    }
    std::vector<ProfileChoice> choices;
    choices.reserve(byRows.size());
    size_t enough = 0; // the rows of the best profile that fits
    for (const auto& [most, profile] : byRows)
    {
        if (most < enough)
            break;
        choices.push_back(Read(*profile, skeletons));
        const RowMatch& match = choices.back().match;
        enough = std::max(enough, match.IsWhole() ? static_cast<size_t>(match.rowCount) : 0);
    }
    return choices;
}

} // namespace

std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot, EJudged judged)
{
    std::deque<std::string> texts;
    std::vector<LoadedProfile> profiles;
    for (const std::string& path : paths)
    {
        if (std::string text; ReadProfileText(path, text))
            profiles.push_back({path, texts.emplace_back(std::move(text))});
    }
    return ChooseProfile(profiles, CBoneNames(&sourceRoot), CBoneNames(&targetRoot), judged);
}

std::vector<ProfileChoice> ChooseProfile(std::span<const LoadedProfile> profiles, const CBoneNames& sources,
                                         const CBoneNames& targets, EJudged judged)
{
    CSkeletons skeletons(sources, targets);
    std::vector<ProfileChoice> choices;
    if (judged == EJudged::First)
        choices = ReadPromising(profiles, skeletons);
    if (!AnyFits(choices))
        choices = ReadAll(profiles, skeletons);
    if (!AnyFits(choices))
        std::ranges::move(AdaptToPrefix(choices, skeletons), std::back_inserter(choices));
    JudgeWhole(choices, skeletons, judged);
    std::ranges::stable_sort(choices, std::greater(), Rank);
    return choices;
}

} // namespace gw
