#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// A bone of the result and the source bone that drives it. Neither is null, neither is kept alive.
struct BonePair
{
    CNode* target = nullptr;
    CNode* source = nullptr;
};

/// A mapping row of which a bone is missing.
struct PairMisfit
{
    size_t line = 0; ///< in the profile, from 1 on
    std::string source;
    std::string target;
    bool sourceFound = false;
    bool targetFound = false;
};

/// Reads which bones a profile pairs, in the order of its rows; of two rows for one target the later one
/// counts, and fixed rows pair nothing. Rows that do not fit go into `misfits`. False, and nothing is
/// changed, when the profile cannot be read.
bool ReadBonePairs(const std::string& profilePath, CNode* sourceRoot, CNode* resultRoot,
                   std::vector<BonePair>& pairs, std::vector<PairMisfit>& misfits);

/// Pairs by target.
class CSourceTable
{
public:
    explicit CSourceTable(std::span<const BonePair> pairs);

    /// The source of a target bone, or null.
    CNode* SourceOf(const CNode* target) const;

private:
    std::unordered_map<const CNode*, CNode*> m_kSource;
};

} // namespace gw
