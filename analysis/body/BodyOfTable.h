#pragma once

#include "CBodyMap.h"

namespace gw {

class CNodeNames;
class CRetargeter;

/// Returns the body that the rows of a retargeter's table describe: the source joints that drive the target's
/// bones, with the joints between hip, neck and head taken from the source's tree. If no row names a toe, it
/// is the only child joint of the foot. A torso bone driven from outside the spine (a collar) adds no joint.
CBodyMap BodyOfTable(const CRetargeter& table, const CNodeNames& targets);

} // namespace gw
