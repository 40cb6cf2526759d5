#pragma once

namespace gw {

class CNode;
class CSourceTable;
struct BonePair;

/// The joints that the directions of a pair of bones lead to; null where a side's bone is an end joint.
struct BoneEnds
{
    CNode* target = nullptr;
    CNode* source = nullptr;
    CNode* sourceStart = nullptr; ///< where the source's direction begins; never null
};

/// Finds them by the rule of BoneMeasures. Both trees are posed, so that helper joints at the place of their
/// parents can be told and passed over.
BoneEnds FindBoneEnds(const BonePair& pair, const CSourceTable& sources);

} // namespace gw
