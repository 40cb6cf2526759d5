#pragma once

namespace gw {

class CNode;
class CSourceTable;
struct BonePair;

/// The joints that define the directions of a pair of bones; null if a side's bone is an end joint.
struct BoneEnds
{
    CNode* target = nullptr;
    CNode* source = nullptr;
    CNode* sourceStart = nullptr; ///< start of the source's direction; never null
};

/// Finds them by the rule of BoneMeasures. Both trees must be posed, so that helper joints at their parents'
/// place can be recognized and skipped.
BoneEnds FindBoneEnds(const BonePair& pair, const CSourceTable& sources);

} // namespace gw
