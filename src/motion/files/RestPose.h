#pragma once

#include "CFailureRecord.h"

namespace gw {

class CNode;

/// Warns if the rest pose of a motion's tree is not a T-pose, that is, if an arm does not point sideways. A
/// skeleton whose arms cannot be found by hand names is not checked.
void JudgeRestPose(CNode& motionRoot, CFailureRecord& record);

} // namespace gw
