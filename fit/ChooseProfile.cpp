#include "ChooseProfile.h"

#include "CRetargeter.h"
#include "FindBodyByNames.h"
#include "FindBone.h"
#include "SharedPrefix.h"

#include <algorithm>
#include <tuple>

namespace gw {

namespace {

// Both skeletons with their names, for all profiles.
struct Skeletons
{
    Skeletons(CNode& source, CNode& targetRoot)
        : target(targetRoot), sourceNames(&source), targetNames(&targetRoot), byNames(FindBodyByNames(source))
    {
    }

    CNode& target;
    CBoneNames sourceNames;
    CBoneNames targetNames;
    CBodyMap byNames;
};

struct Candidate
{
    ProfileRows rows;
    ProfileChoice choice;
    size_t kinship = 0; ///< how much of its own prefix stands in the source's
};

ProfileVerdict Judge(const ProfileRows& profile, const Skeletons& skeletons, RowMatch& match)
{
    CRetargeter table;
    match = ApplyRows(profile.rows, skeletons.sourceNames, skeletons.targetNames, table);
    return match.IsWhole() ? JudgeProfile(table, skeletons.target, skeletons.byNames) : ProfileVerdict();
}

std::vector<Candidate> ReadCandidates(std::span<const std::string> paths, const Skeletons& skeletons)
{
    std::vector<Candidate> candidates;
    for (const std::string& path : paths)
    {
        Candidate candidate;
        if (!ReadProfileRows(path, candidate.rows))
            continue;
        candidate.choice.path = path;
        candidate.choice.name = candidate.rows.name;
        candidate.choice.verdict = Judge(candidate.rows, skeletons, candidate.choice.match);
        candidates.push_back(std::move(candidate));
    }
    return candidates;
}

// Larger is better. A profile whose rows do not all fit is judged by nothing else than their share.
auto Rank(const Candidate& candidate)
{
    const RowMatch& match = candidate.choice.match;
    const ProfileVerdict& verdict = candidate.choice.verdict;
    const bool whole = match.IsWhole();
    const double share = whole ? 1.0 : static_cast<double>(match.mappedCount) / std::max(match.rowCount, 1);
    return std::tuple(whole, share, whole ? match.rowCount : 0, verdict.sureness != ESureness::Doubtful,
                      -static_cast<double>(verdict.leftOut), -verdict.turn, candidate.kinship);
}

Candidate Adapted(const Candidate& candidate, const std::string& ownPrefix, const std::string& prefix,
                  const Skeletons& skeletons)
{
    Candidate adapted = candidate;
    adapted.rows.rows = WithPrefix(candidate.rows.rows, ownPrefix, prefix);
    adapted.rows.name += prefix.empty() ? ", no prefix" : ", prefix " + prefix;
    adapted.kinship = CommonStart(std::array<std::string_view, 2>{ownPrefix, prefix}).size();
    ProfileChoice& choice = adapted.choice;
    choice.verdict = Judge(adapted.rows, skeletons, choice.match);
    choice.name = adapted.rows.name;
    choice.text = TextOf(adapted.rows);
    return adapted;
}

std::vector<Candidate> AdaptedOnes(const std::vector<Candidate>& candidates, const Skeletons& skeletons)
{
    std::vector<std::string> prefixes = SharedPrefixes(skeletons.sourceNames.Names());
    prefixes.emplace_back();
    std::vector<Candidate> whole;
    for (const Candidate& candidate : candidates)
    {
        const std::string ownPrefix = SourcePrefix(candidate.rows.rows);
        for (const std::string& prefix : prefixes)
        {
            if (prefix == ownPrefix)
                continue;
            Candidate adapted = Adapted(candidate, ownPrefix, prefix, skeletons);
            if (adapted.choice.match.IsWhole())
                whole.push_back(std::move(adapted));
        }
    }
    return whole;
}

} // namespace

std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot)
{
    const Skeletons skeletons(sourceRoot, targetRoot);
    std::vector<Candidate> candidates = ReadCandidates(paths, skeletons);
    const auto fits = [](const Candidate& candidate) { return candidate.choice.match.IsWhole(); };
    if (std::ranges::none_of(candidates, fits))
    {
        std::vector<Candidate> adapted = AdaptedOnes(candidates, skeletons);
        std::ranges::move(adapted, std::back_inserter(candidates));
    }
    std::ranges::stable_sort(candidates, std::greater(), Rank);
    std::vector<ProfileChoice> choices;
    for (Candidate& candidate : candidates)
        choices.push_back(std::move(candidate.choice));
    return choices;
}

} // namespace gw
