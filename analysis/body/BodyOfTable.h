#pragma once

#include "CBodyMap.h"

namespace gw {

class CNodeNames;
class CRetargeter;

/// The body that the rows of a retargeter's table tell of a source skeleton: what drives the target's bones,
/// with the joints between hip, neck and head as the source's tree has them. A toe is the only child joint of
/// a foot where no row names it. A torso bone that is driven from outside the spine (a collar) names no
/// joint.
CBodyMap BodyOfTable(const CRetargeter& table, const CNodeNames& targets);

} // namespace gw
