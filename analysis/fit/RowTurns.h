#pragma once

#include "BodyStance.h"

#include <vector>

namespace gw {

class CNodeNames;
class CRestWorlds;
class CRetargeter;

/// How far a row rotates its target bone away from the source's limb, about all axes.
struct RowTurn
{
    CNode* target = nullptr;
    double degrees = 0.0; ///< mean over the examined poses
};

/// Compares the effect of a table's row offsets on the source with the target's rest pose, in which each bone
/// is swung by the smallest rotation to the source bone's direction; the difference is a misrotated bone.
/// Uses the source's rest pose if it is a standing pose, otherwise some frames of its motion. Thighs and
/// calves are not reported, because planting rotates them anyway; nothing is reported without both arms and
/// legs. The source's nodes are restored. `worlds` can be shared by all tables of one source and target.
std::vector<RowTurn> MeasureTurns(const CRetargeter& table, const CNodeNames& targets, const CBodyMap& body,
                                  const BodyStance& rest, CRestWorlds& worlds);

} // namespace gw
