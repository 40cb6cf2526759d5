#pragma once

#include "MotionFacts.h"

namespace gw {

class CFindings;
struct BVHOutline;
class CMotionFile;

/// What can be told of a motion only when it moves: a root that stands still, a rate that does not go with
/// the steps, sides that are swapped. Answers what is known of it beside. The motion must be loaded; leaves
/// its tree posed. The outline of its text tells lines; null where there is none.
MotionFacts CheckPoses(const CMotionFile& motion, const BVHOutline* outline, CFindings& findings);

} // namespace gw
