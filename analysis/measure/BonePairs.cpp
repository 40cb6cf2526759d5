#include "BonePairs.h"

#include "FindBone.h"
#include "ProfileFile.h"

#include <algorithm>

namespace gw {

namespace {

void SetPair(std::vector<BonePair>& pairs, const BonePair& pair)
{
    const auto known = std::ranges::find(pairs, pair.target, &BonePair::target);
    if (known == pairs.end())
        pairs.push_back(pair);
    else
        known->source = pair.source;
}

} // namespace

bool ReadBonePairs(const std::string& profilePath, CNode* sourceRoot, CNode* resultRoot,
                   std::vector<BonePair>& pairs, std::vector<MissingBone>& missing)
{
    std::string text;
    const bool isRead = ReadProfileText(profilePath, text);
    if (isRead)
        PairBones(text, sourceRoot, resultRoot, pairs, missing);
    return isRead;
}

void PairBones(std::string_view profileText, CNode* sourceRoot, CNode* resultRoot,
               std::vector<BonePair>& pairs, std::vector<MissingBone>& missing)
{
    const CBoneNames sources(sourceRoot);
    const CBoneNames targets(resultRoot);
    CProfileReader reader(profileText);
    for (ProfileLine line; reader.Next(line);)
    {
        if (line.kind != EProfileLine::Mapping)
            continue;
        const BonePair pair{targets.Find(line.target), sources.Find(line.source)};
        if (pair.target && pair.source)
            SetPair(pairs, pair);
        else if (!pair.source)
            missing.push_back({ESkeletonSide::Source, std::string(line.source), {}, 0, line.line});
        else
            missing.push_back({ESkeletonSide::Target, std::string(line.target), {}, 0, line.line});
    }
}

CSourceTable::CSourceTable(std::span<const BonePair> pairs)
{
    for (const BonePair& pair : pairs)
        m_kSource[pair.target] = pair.source;
}

CNode* CSourceTable::SourceOf(const CNode* target) const
{
    const auto found = m_kSource.find(target);
    return found == m_kSource.end() ? nullptr : found->second;
}

} // namespace gw
