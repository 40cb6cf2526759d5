#pragma once

#include "MotionFacts.h"

namespace gw {

class CFindings;
struct BVHOutline;
class CMotionFile;

/// Returns the facts about a motion, and finds faults that are visible only when it moves: a root that does
/// not move, a rate that does not match the steps, swapped sides. The motion must be loaded; its tree is left
/// posed. `outline` supplies the lines of findings and may be null.
MotionFacts CheckPoses(const CMotionFile& motion, const BVHOutline* outline, CFindings& findings);

} // namespace gw
