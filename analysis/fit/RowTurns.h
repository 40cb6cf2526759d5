#pragma once

#include "BodyStance.h"

#include <vector>

namespace gw {

class CNodeNames;
class CRetargeter;

/// How far a row leaves its target bone from where the source's limb has it, about all axes.
struct RowTurn
{
    CNode* target = nullptr;
    double degrees = 0.0; ///< mean over the poses looked at
};

/// Compares what the offsets of a retargeter's rows make of the source with the target's rest pose, each bone
/// of it swung the shortest way to the direction that the source's bone has: what is left is a frame that
/// stands across. Looked at is the source's rest pose where a body stands in it, else some frames of its
/// motion. Thighs and calves are not told, since planting turns them anyway; nothing is, where the body has
/// not both arms and legs. The source's nodes are as they were when this returns.
std::vector<RowTurn> MeasureTurns(const CRetargeter& table, const CNodeNames& targets, const CBodyMap& body,
                                  const BodyStance& rest);

} // namespace gw
