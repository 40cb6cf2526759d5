#pragma once

#include "CFailure.h"

namespace gw {

class CNode;

/// Warns where the rest pose of a motion's tree is no T-pose: where an arm does not point sideways. A
/// skeleton whose arms are not found by the names of its hands is not judged.
void JudgeRestPose(CNode& motionRoot, CFailureRecord& record);

} // namespace gw
