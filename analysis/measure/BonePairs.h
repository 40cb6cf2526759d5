#pragma once

#include "ProfileFit.h"

#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// A bone of the result and the source bone that drives it. Neither is null or kept alive.
struct BonePair
{
    CNode* target = nullptr;
    CNode* source = nullptr;
};

/// Reads the bone pairs of a profile, in row order. If a target has two rows, the later one counts; fixed
/// rows pair nothing. For each row that does not fit, `missing` gets its source, or else its target. Returns
/// false, changing nothing, if the profile cannot be read.
bool ReadBonePairs(const std::string& profilePath, CNode* sourceRoot, CNode* resultRoot,
                   std::vector<BonePair>& pairs, std::vector<MissingBone>& missing);
/// Same for the text of a profile.
void PairBones(std::string_view profileText, CNode* sourceRoot, CNode* resultRoot,
               std::vector<BonePair>& pairs, std::vector<MissingBone>& missing);

/// Maps targets to their sources.
class CSourceTable
{
public:
    explicit CSourceTable(std::span<const BonePair> pairs);

    /// Returns the source of a target bone, or null.
    CNode* SourceOf(const CNode* target) const;

private:
    std::unordered_map<const CNode*, CNode*> m_kSource;
};

} // namespace gw
