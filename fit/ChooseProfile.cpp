#include "ChooseProfile.h"

#include "CRetargeter.h"
#include "FindBone.h"
#include "SharedPrefix.h"
#include "Text.h"

#include <algorithm>
#include <array>
#include <functional>
#include <map>
#include <optional>
#include <tuple>

namespace gw {

namespace {

// Both skeletons, looked at once for all profiles.
class CSkeletons
{
public:
    CSkeletons(CNode& source, CNode& target)
        : m_kSource(source), m_kTarget(target), m_kSourceNames(&source), m_kTargetNames(&target)
    {
    }

    void Hold(ProfileChoice& choice);
    const std::vector<std::string>& SourceNames() const { return m_kSourceNames.Names(); }

private:
    // What takes a walk over poses waits for the first profile that fits.
    const SourceBody& Body()
    {
        if (!m_kBody)
            m_kBody.emplace(m_kSource);
        return *m_kBody;
    }

    CNode& m_kSource;
    CNode& m_kTarget;
    CBoneNames m_kSourceNames;
    CBoneNames m_kTargetNames;
    std::optional<SourceBody> m_kBody;
};

void CSkeletons::Hold(ProfileChoice& choice)
{
    CRetargeter table;
    choice.match = ApplyRows(choice.profile.rows, m_kSourceNames, m_kTargetNames, table);
    if (choice.match.IsWhole())
        choice.verdict = JudgeProfile(table, m_kTarget, Body());
}

// Larger is better. A profile of which rows do not fit is ranked by the share of those that do.
auto Rank(const ProfileChoice& choice)
{
    const RowMatch& match = choice.match;
    const ProfileVerdict& verdict = choice.verdict;
    const bool whole = match.IsWhole();
    const double share = whole ? 1.0 : static_cast<double>(match.mappedCount) / std::max(match.rowCount, 1);
    return std::tuple(whole, share, whole ? match.rowCount : 0, verdict.sureness != ESureness::Doubtful,
                      -static_cast<double>(verdict.leftOut), -verdict.turn);
}

ProfileChoice Adapted(const ProfileChoice& choice, const std::string& ownPrefix, const std::string& prefix)
{
    ProfileChoice adapted = choice;
    adapted.adapted = true;
    adapted.profile.rows = WithPrefix(choice.profile.rows, ownPrefix, prefix);
    adapted.profile.name += prefix.empty() ? ", no prefix" : ", prefix " + prefix;
    return adapted;
}

// Those with much of the source's prefix as their own come first: their names say most about it.
std::vector<ProfileChoice> AdaptedOnes(const std::vector<ProfileChoice>& choices, CSkeletons& skeletons)
{
    std::vector<std::string> prefixes = SharedPrefixes(skeletons.SourceNames());
    prefixes.emplace_back();
    std::multimap<size_t, ProfileChoice, std::greater<>> byKinship;
    for (const ProfileChoice& choice : choices)
    {
        const std::string ownPrefix = SourcePrefix(choice.profile.rows);
        for (const std::string& prefix : prefixes)
        {
            if (EqualNoCase(prefix, ownPrefix))
                continue;
            ProfileChoice adapted = Adapted(choice, ownPrefix, prefix);
            skeletons.Hold(adapted);
            const std::array<std::string_view, 2> both{ownPrefix, prefix};
            if (adapted.match.IsWhole())
                byKinship.emplace(CommonStart(both).size(), std::move(adapted));
        }
    }
    std::vector<ProfileChoice> whole;
    for (auto& [kinship, adapted] : byKinship)
        whole.push_back(std::move(adapted));
    return whole;
}

} // namespace

std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot)
{
    CSkeletons skeletons(sourceRoot, targetRoot);
    std::vector<ProfileChoice> choices;
    for (const std::string& path : paths)
    {
        ProfileChoice choice;
        choice.path = path;
        if (!ReadProfileRows(path, choice.profile))
            continue;
        skeletons.Hold(choice);
        choices.push_back(std::move(choice));
    }
    const auto fits = [](const ProfileChoice& choice) { return choice.match.IsWhole(); };
    if (std::ranges::none_of(choices, fits))
        std::ranges::move(AdaptedOnes(choices, skeletons), std::back_inserter(choices));
    std::ranges::stable_sort(choices, std::greater(), Rank);
    return choices;
}

} // namespace gw
